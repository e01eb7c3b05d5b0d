#pragma once

#include "foundation/zebcore/Export.h"
#include "host/PluginLocator.h"
#include "host/StaticBanEntry.h"
#include "utility/CommonTypes.h"

#include <set>
#include <vector>

namespace zebaudiofilterhost
{

/// The two lists of plug-ins that must not be touched. The dynamic list is the application's, kept while it runs, and
/// holds what took the process down; searches leave its plug-ins out. The permanent list is shipped, read-only, and
/// consulted when a plug-in is scanned. When either is loaded or saved is up to the application. All operations:
/// [main]
class ZEB_EXPORT BannedPluginManager
{
public:
    using BannedIterator = std::set<PluginLocator>::const_iterator;

    /// Lives until process exit.
    static BannedPluginManager& GetInstance();

    BannedPluginManager(const BannedPluginManager&) = delete;
    BannedPluginManager& operator=(const BannedPluginManager&) = delete;

    /// The file's list replaces the dynamic list. A file that is missing or of another version changes nothing.
    /// Exceptions of the file layer pass through.
    void LoadConfiguration(File& file);
    void SaveConfiguration(File& file) const;
    void ReadBannedPlugins(const PropList& list);
    void WriteBannedPlugins(PropList& list) const;
    /// The file's entries replace the permanent list. False, with the list as it was, when the file is missing or
    /// broken. The file is XML, <pluginlist><plugin filename="X.vst3" uniqueid="" version=""/></pluginlist>, with an
    /// entry for each plug-in; how they are compared stands at IsPluginBannedStatically.
    bool LoadStaticConfiguration(File& file);

    void AddBannedPlugin(const PluginLocator& locator);
    void RemoveBannedPlugin(const PluginLocator& locator);
    bool IsPluginBanned(const PluginLocator& locator) const;
    /// `fileName` with extension. An entry's empty unique ID or version fits any; letters from A to Z compare without
    /// case. A scan asks for VST 2 with ID and version in decimals, for VST 3 with "none" and "0", and for an Audio
    /// Unit with its ID as both names and no version.
    bool IsPluginBannedStatically(const UTF16String& fileName, const UTF16String& uniqueID,
                                  const UTF16String& version) const;
    /// Over the dynamic list, in locator order.
    BannedIterator BannedBegin() const;
    BannedIterator BannedEnd() const;

    /// Names without a directory: "DynamicAudioPlugInBlacklist.xml" and "PermanentAudioPlugInBlacklist.xml" until
    /// set.
    void SetSettingsFileName(const UTF16String& name);
    UTF16String GetSettingsFileName() const;
    void SetPermanentBannedSettingsFileName(const UTF16String& name);
    UTF16String GetPermanentBannedSettingsFileName() const;

private:
    BannedPluginManager();
    ~BannedPluginManager();

    std::set<PluginLocator> mBannedPlugins;
    std::vector<StaticBanEntry> mStaticEntries;
    UTF16String mSettingsFileName;
    UTF16String mPermanentBannedSettingsFileName;
};

} // namespace zebaudiofilterhost
