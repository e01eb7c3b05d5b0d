#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <list>
#include <memory>
#include <vector>

namespace zebcore::proplist
{

class PropListVisitor;

/// A hierarchical store of typed values and named sub-lists: the form of all settings and presets.
///
/// - Entries keep the order in which their keys were first set. Looking a key up takes constant time.
/// - A key names one entry, a value or a sub-list. Setting it again replaces the entry, whatever its type, in its
/// place.
/// - Types are strict: what was stored as an `int` is read as an `int` and as nothing else.
/// - A list owns its sub-lists. References to one stay good until its entry is removed or replaced, or the list that
///   holds it is cleared, assigned to or destroyed.
/// - Copies are deep. The accessors are virtual so that a wrapper may stand in for a list; one that gets its entries
///   from elsewhere shows them in Visit, too; IsEmpty and RemoveValue go by its own store.
///
/// No locks: a list belongs to one thread at a time. All operations: [any], from the thread that owns the list.
class ZEB_EXPORT PropList
{
public:
    PropList();
    PropList(const PropList& other);
    PropList& operator=(const PropList& other);
    virtual ~PropList();

    /// Each getter returns whether the key holds a value of the target's type. If not, the target stays as it is.
    virtual bool GetValue(const UTF8String& key, UTF16String& value) const;
    virtual void SetValue(const UTF8String& key, const UTF16String& value);
    virtual bool GetValue(const UTF8String& key, UTF8String& value) const;
    virtual void SetValue(const UTF8String& key, const UTF8String& value);
    virtual bool GetValue(const UTF8String& key, bool& value) const;
    virtual void SetValue(const UTF8String& key, const bool& value);
    virtual bool GetValue(const UTF8String& key, unsigned int& value) const;
    virtual void SetValue(const UTF8String& key, const unsigned int& value);
    virtual bool GetValue(const UTF8String& key, int& value) const;
    virtual void SetValue(const UTF8String& key, const int& value);
    virtual bool GetValue(const UTF8String& key, float& value) const;
    virtual void SetValue(const UTF8String& key, const float& value);
    virtual bool GetValue(const UTF8String& key, std::list<float>& value) const;
    virtual void SetValue(const UTF8String& key, const std::list<float>& value);

    /// Null if the key is missing or holds a value. The sub-list belongs to this list.
    virtual const PropList* GetSubList(const UTF8String& key) const;

    /// The sub-list of the key; an empty one is made if there is none. A value under the key is replaced by it.
    virtual PropList& GetOrCreateSubList(const UTF8String& key);

    virtual void Clear();

    /// Shows all entries to the visitor, in order. Sub-lists are not entered.
    virtual void Visit(PropListVisitor& visitor) const;

    PropList* GetSubList(const UTF8String& key);

    bool IsEmpty() const;

    /// Removes the value or sub-list of the key, if there is one.
    void RemoveValue(const UTF8String& key);

    /// The keys of all sub-lists, in order.
    std::vector<UTF8String> GetSubListKeys() const;

    /// Exchanges the entries of two lists. References to sub-lists stay good.
    void Swap(PropList& other) noexcept;

    /// String literals are strings. Without these they would quietly be stored as `bool`.
    void SetValue(const UTF8String& key, const char16_t* value) { SetValue(key, UTF16String(value)); }
    void SetValue(const UTF8String& key, const char8_t* value) { SetValue(key, UTF8String(value)); }
    template <typename T>
    void SetValue(const UTF8String& key, T* value) = delete;

    /// A text that its owner is done with is taken over instead of copied.
    void SetValue(const UTF8String& key, UTF16String&& value);
    void SetValue(const UTF8String& key, UTF8String&& value);

private:
    class Entries;

    template <typename Text>
    void Take(const UTF8String& key, Text&& value);

    std::unique_ptr<Entries> mEntries;
};

} // namespace zebcore::proplist
