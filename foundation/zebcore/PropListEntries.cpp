#include "foundation/zebcore/internal/PropListEntries.h"

namespace zebcore::proplist
{

const PropList::Entries::Value* PropList::Entries::Find(const UTF8String& key) const
{
    const auto found = mIndex.find(key);
    return found == mIndex.end() ? nullptr : &found->second->mValue;
}

PropList::Entries::Value* PropList::Entries::Find(const UTF8String& key)
{
    const auto found = mIndex.find(key);
    return found == mIndex.end() ? nullptr : &found->second->mValue;
}

PropList::Entries::Value& PropList::Entries::Set(const UTF8String& key, Value value)
{
    if (Value* const existing = Find(key))
    {
        // What was there dies last: the new value may have been made from it.
        std::swap(*existing, value);
        return *existing;
    }
    const auto entry = mEntries.insert(mEntries.end(), Entry{key, std::move(value)});
    try
    {
        mIndex.emplace(entry->mKey, entry);
    }
    catch (...)
    {
        mEntries.erase(entry);
        throw;
    }
    return entry->mValue;
}

void PropList::Entries::Remove(const UTF8String& key)
{
    const auto found = mIndex.find(key);
    if (found == mIndex.end())
        return;
    const Iterator entry = found->second;
    mIndex.erase(found);
    mEntries.erase(entry);
}

void PropList::Entries::Clear()
{
    mIndex.clear();
    mEntries.clear();
}

} // namespace zebcore::proplist
