#include "foundation/zebcore/DebugDatabase.h"

namespace zebcore::debug
{

DebugDatabase& DebugDatabase::Instance()
{
    static DebugDatabase& database = *new DebugDatabase;
    return database;
}

UTF8String DebugDatabase::GetEntry(const UTF8String& key, const UTF8String& defaultText) const
{
    const auto entry = mEntries.find(key);
    return entry != mEntries.end() ? entry->second : defaultText;
}

void DebugDatabase::SetEntry(const UTF8String& key, const UTF8String& text)
{
    mEntries.insert_or_assign(key, text);
}

void DebugDatabase::RemoveEntry(const UTF8String& key)
{
    mEntries.erase(key);
}

} // namespace zebcore::debug
