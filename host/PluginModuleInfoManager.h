#pragma once

#include "foundation/zebcore/Export.h"
#include "host/PluginLocator.h"
#include "host/PluginModuleInfo.h"
#include "host/PluginTechnology.h"
#include "utility/CommonTypes.h"

#include <boost/signals2/signal.hpp>
#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <map>
#include <memory>
#include <vector>

namespace zebaudiofilterhost
{

class PluginModuleRecords;

/// All technologies, and the records of all plug-in binaries; reads and writes the settings file. It opens no file by
/// itself: the application stores the private configuration, calls LoadConfiguration, CollectPotentialPlugins,
/// RemovePluginLocators, runs a PluginModuleScanner, and calls SaveConfiguration, in this order. All operations:
/// [main]
class ZEB_EXPORT PluginModuleInfoManager
{
public:
    using TechnologyPtr = boost::intrusive_ptr<PluginTechnology>;
    using PluginInfoPtr = boost::intrusive_ptr<PluginModuleInfo>;
    using PluginInfoMap = std::map<PluginLocator, PluginInfoPtr>;
    using PluginInfoVector = std::vector<PluginInfoPtr>;
    using PluginInfoIterator = PluginInfoVector::const_iterator;
    using PluginInfosChangedSignal = boost::signals2::signal<void()>;

    /// Lives until process exit.
    static PluginModuleInfoManager& GetInstance();

    PluginModuleInfoManager(const PluginModuleInfoManager&) = delete;
    PluginModuleInfoManager& operator=(const PluginModuleInfoManager&) = delete;

    /// The first technology of a type stays; null is ignored. [main], or a static initializer
    void AddPluginTechnology(TechnologyPtr technology);
    /// Null if there is none.
    TechnologyPtr GetPluginTechnology(TechnologyType type) const;
    /// In the order of TechnologyType.
    std::vector<TechnologyPtr> GetPluginTechnologies() const;

    /// Replaces the record of the same locator, enabled flag and all, and emits the signal. Null is ignored.
    void AddPluginModuleInfo(PluginInfoPtr info);
    /// All records in order of arrival. Every change of the records invalidates the iterators.
    PluginInfoIterator PluginInfoBegin() const;
    PluginInfoIterator PluginInfoEnd() const;
    /// Emitted after the records have changed; slots run in the thread of the change.
    PluginInfosChangedSignal& GetPluginInfosChangedSignal();
    /// Null if there is no record.
    PluginInfoPtr FindPluginInfo(const PluginLocator& locator) const;
    /// Both in locator order.
    std::vector<PluginLocator> GetPluginLocators() const;
    std::vector<PluginLocator> GetEnabledPlugins() const;
    /// Without a record, the negation of `unknownIsDisabled`.
    bool IsPluginEnabled(const PluginLocator& locator, bool unknownIsDisabled) const;
    /// Does nothing without a record. No signal.
    void SetPluginEnabled(const PluginLocator& locator, bool enabled);

    /// Work on the containers given, which hold no null pointers. A record that the map has, by its locator, is
    /// replaced, and the first one of that locator leaves the vector. So of two sections with one locator the later
    /// wins. With `merge` false both containers are emptied first.
    void ReadPluginInfos(const PropList& list, PluginInfoMap& infos, PluginInfoVector& order, bool merge) const;
    void WritePluginInfos(PropList& list) const;
    /// A technology without a section keeps its directories.
    void ReadDirectories(const PropList& list) const;
    void WriteDirectories(PropList& list) const;

    /// A file that is missing or of another version counts as none: then the external descriptors are those of the
    /// private configuration, and directories go back to default if there are no records; records stay, so call
    /// ClearAll first when there are some. Emits the signal. Exceptions of the file layer pass through.
    void LoadConfiguration(File& file);
    /// Ends silently when the old file cannot be deleted; other exceptions of the file layer pass through. Without
    /// directories, a later start calls ResetToDefaultFolders ahead of LoadConfiguration: a search without folders
    /// finds no VST 2 plug-in, and calls the recorded ones gone.
    void SaveConfiguration(File& file, bool withDirectories) const;
    void BuildConfigurationPropList(PropList& list, bool withDirectories) const;
    /// What SaveConfiguration would write, directories included.
    UTF8String GetConfigurationAsXML() const;
    /// Merges records and external descriptors of such a text; its version and directories are ignored. `notify`
    /// emits the signal.
    void AddConfiguration(const UTF8String& text, bool notify);
    /// Keeps the text's content for LoadConfiguration and ClearAll; no effect before.
    void SetPrivatePluginConfiguration(const UTF8String& text);
    /// Drops all records and external descriptors; the private ones come back unless `withoutPrivate`. No signal.
    void ClearAll(bool withoutPrivate);

    void ResetToDefaultFolders() const;
    /// What is on disk, as each technology finds it: all of it, or with `onlyNew` what has no record. `removed`
    /// receives the recorded plug-ins that are no longer found. A plug-in that changed in place is not noticed. An
    /// Audio Unit may come twice. Give what has a record, and is to be scanned again, to RemovePluginLocators first:
    /// its filters would stand in the catalogue twice, and the old ones answer.
    std::vector<PluginLocator> CollectPotentialPlugins(bool onlyNew, std::vector<PluginLocator>& removed) const;
    /// Drops records with their descriptors; a locator without a record is skipped, and its descriptors stay. Emits
    /// the signal once if at least one record went.
    void RemovePluginLocators(const std::vector<PluginLocator>& locators);
    /// Text for the user; the path when its technology has nothing better.
    UTF16String GetDisplayStringForLocator(const PluginLocator& locator) const;

    /// The name only, without a directory; "AudioPluginManagerSettings.xml" until set.
    void SetSettingsFileName(const UTF16String& name);
    UTF16String GetSettingsFileName() const;

private:
    PluginModuleInfoManager();
    ~PluginModuleInfoManager();

    void EnterRecords(const PropList& list);
    void LoadCurrentConfiguration(const PropList& list);
    void LoadWithoutFile();
    void ReadTechnologyDirectories(const PropList& section) const;

    std::map<TechnologyType, TechnologyPtr> mTechnologies;
    std::unique_ptr<PluginModuleRecords> mRecords;
    PluginInfosChangedSignal mPluginInfosChangedSignal;
    PropList mPrivatePluginConfiguration;
    UTF16String mSettingsFileName;
};

} // namespace zebaudiofilterhost
