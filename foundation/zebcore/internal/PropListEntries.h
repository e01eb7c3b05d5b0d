#pragma once

#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/internal/PositionTable.h"

#include <cstddef>
#include <list>
#include <memory>
#include <string_view>
#include <variant>
#include <vector>

namespace zebcore::proplist
{

// What a PropList holds: the entries in order of arrival. The many lists with a few entries are searched one by one;
// a longer one gets an index over the hashes of its keys.
class PropList::Entries
{
public:
    using SubList = std::unique_ptr<PropList>; // never null
    using Value = std::variant<UTF16String, UTF8String, bool, unsigned int, int, float, std::list<float>, SubList>;

    struct Entry
    {
        UTF8String mKey; // never changes
        Value mValue;
    };

    const Value* Find(const UTF8String& key) const;
    Value* Find(const UTF8String& key);

    // Replaces the value under the key in its place, or appends it. Returns where it stands until the next change.
    Value& Set(const UTF8String& key, Value value);

    void Remove(const UTF8String& key);
    void Clear();

    const std::vector<Entry>& InOrder() const { return mEntries; }

private:
    std::size_t Position(std::u8string_view key) const;
    void Append(const UTF8String& key, Value&& value);
    void BuildIndex();

    std::vector<Entry> mEntries;
    utility::PositionTable mIndex; // empty for a short list
};

} // namespace zebcore::proplist
