#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <concepts>
#include <map>

namespace zebcore::debug
{

/// Process-wide table of debug settings, filled by the application.
class ZEB_EXPORT DebugDatabase
{
public:
    /// Never destroyed. [any]
    static DebugDatabase& Instance();

    /// The text of the key, or the default. [main]
    UTF8String GetEntry(const UTF8String& key, const UTF8String& defaultText) const;

    /// Whether the entry reads "true" exactly; any other text is false. [main]
    template <class T>
    requires std::same_as<T, bool>
    bool GetEntryAs(const UTF8String& key, bool defaultValue) const
    {
        return GetEntry(key, defaultValue ? u8"true" : u8"false") == u8"true";
    }

    /// [main]
    void SetEntry(const UTF8String& key, const UTF8String& text);
    /// Back to the readers' defaults. [main]
    void RemoveEntry(const UTF8String& key);

private:
    std::map<UTF8String, UTF8String> mEntries;
};

} // namespace zebcore::debug
