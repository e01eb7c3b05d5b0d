#pragma once

#include "foundation/zebcore/PropList.h"

#include <list>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <variant>

namespace zebcore::proplist
{

// What a PropList holds: the entries in order of arrival, and an index over their keys.
class PropList::Entries
{
public:
    using SubList = std::unique_ptr<PropList>; // never null
    using Value = std::variant<UTF16String, UTF8String, bool, unsigned int, int, float, std::list<float>, SubList>;

    struct Entry
    {
        const UTF8String mKey;
        Value mValue;
    };

    const Value* Find(const UTF8String& key) const;
    Value* Find(const UTF8String& key);

    // Replaces the value under the key in its place, or appends it. Returns where it stands now.
    Value& Set(const UTF8String& key, Value value);

    void Remove(const UTF8String& key);
    void Clear();

    const std::list<Entry>& InOrder() const { return mEntries; }

private:
    using Iterator = std::list<Entry>::iterator;

    std::list<Entry> mEntries;
    std::unordered_map<std::u8string_view, Iterator> mIndex; // the views are of the entries' own keys
};

} // namespace zebcore::proplist
