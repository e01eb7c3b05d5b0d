#include "host/PluginModuleInfoManager.h"

#include "foundation/zebcore/File.h"
#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/PropListUtils.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/src/EntryForwarder.h"
#include "host/src/IndexedKeys.h"
#include "host/src/PluginModuleRecords.h"

#include <cstddef>
#include <map>
#include <queue>

namespace zebaudiofilterhost
{

namespace
{

const UTF8String kKey_ConfigurationVersion = u8"version";
const UTF8String kKey_NumTechInfos = u8"num_tech_infos";
const UTF8String kKey_TechInfo = u8"tech_info";
const UTF8String kKey_TechType = u8"tech_type";
const UTF8String kKey_NumDirectories = u8"num_directories";
const UTF8String kKey_Directories = u8"directories";
const UTF8String kKey_NumPluginInfos = u8"num_plugin_infos";
const UTF8String kKey_PluginInfo = u8"plugin_info";

constexpr unsigned int kConfigurationVersion = 2;

std::vector<UTF16String> ReadDirectoryList(const PropList& section)
{
    int count = 0;
    section.GetValue(kKey_NumDirectories, count);
    std::vector<UTF16String> directories;
    for (const std::size_t index : PresentIndices(section, kKey_Directories, count))
    {
        UTF16String directory;
        section.GetValue(IndexedKey(kKey_Directories, index), directory);
        if (!directory.empty())
        {
            directories.push_back(directory);
        }
    }
    return directories;
}

void WriteTechnologyDirectories(PropList& section, const PluginTechnology& technology)
{
    const std::vector<UTF16String> directories(technology.DirectoryBegin(), technology.DirectoryEnd());
    section.SetValue(kKey_TechType, static_cast<int>(technology.GetType()));
    section.SetValue(kKey_NumDirectories, static_cast<int>(directories.size()));
    for (std::size_t index = 0; index < directories.size(); ++index)
    {
        section.SetValue(IndexedKey(kKey_Directories, index), directories[index]);
    }
}

std::vector<PluginModuleInfoManager::PluginInfoPtr> ReadRecords(const PropList& list)
{
    int count = 0;
    list.GetValue(kKey_NumPluginInfos, count);
    std::vector<PluginModuleInfoManager::PluginInfoPtr> infos;
    for (const PropList* const section : PresentSubLists(list, kKey_PluginInfo, count))
    {
        infos.emplace_back(new PluginModuleInfo(*section));
    }
    return infos;
}

// The settings, made section by section while they are visited: a large catalogue never stands in memory twice.
class SettingsView final : public PropList
{
public:
    SettingsView(const PluginModuleInfoManager& manager, bool withDirectories)
        : mManager(manager), mWithDirectories(withDirectories)
    {
    }

    void Visit(zebcore::proplist::PropListVisitor& visitor) const override
    {
        EntryForwarder forwarder(visitor);
        mManager.BuildConfigurationPropList(forwarder, mWithDirectories);
        forwarder.Finish();
    }

private:
    const PluginModuleInfoManager& mManager;
    bool mWithDirectories;
};

} // namespace

void PluginModuleInfoManager::ReadPluginInfos(const PropList& list, PluginInfoMap& infos, PluginInfoVector& order,
                                              bool merge) const
{
    if (!merge)
    {
        infos.clear();
        order.clear();
    }
    // For each record that is replaced the first of its locator leaves the vector, all of them in one pass at the
    // end: a list full of known plug-ins costs no more than a new one.
    std::map<PluginLocator, std::queue<std::size_t>> places;
    for (std::size_t place = 0; place < order.size(); ++place)
    {
        places[order[place]->GetLocator()].push(place);
    }
    for (const PluginInfoPtr& info : ReadRecords(list))
    {
        std::queue<std::size_t>& same = places[info->GetLocator()];
        if (infos.erase(info->GetLocator()) > 0 && !same.empty())
        {
            order[same.front()] = nullptr;
            same.pop();
        }
        infos.emplace(info->GetLocator(), info);
        same.push(order.size());
        order.push_back(info);
    }
    std::erase(order, PluginInfoPtr());
}

void PluginModuleInfoManager::EnterRecords(const PropList& list)
{
    for (const PluginInfoPtr& info : ReadRecords(list))
    {
        mRecords->Add(info);
    }
}

void PluginModuleInfoManager::WritePluginInfos(PropList& list) const
{
    const PluginInfoVector& infos = mRecords->InOrder();
    list.SetValue(kKey_NumPluginInfos, static_cast<int>(infos.size()));
    for (std::size_t index = 0; index < infos.size(); ++index)
    {
        infos[index]->Write(list.GetOrCreateSubList(IndexedKey(kKey_PluginInfo, index)));
    }
}

void PluginModuleInfoManager::ReadDirectories(const PropList& list) const
{
    int count = 0;
    list.GetValue(kKey_NumTechInfos, count);
    for (const PropList* const section : PresentSubLists(list, kKey_TechInfo, count))
    {
        ReadTechnologyDirectories(*section);
    }
}

void PluginModuleInfoManager::ReadTechnologyDirectories(const PropList& section) const
{
    int type = kTechnologyNone;
    section.GetValue(kKey_TechType, type);
    if (const TechnologyPtr technology = GetPluginTechnology(static_cast<TechnologyType>(type)))
    {
        technology->RemoveAllPluginDirectories();
        technology->AddPluginDirectories(ReadDirectoryList(section));
    }
}

void PluginModuleInfoManager::WriteDirectories(PropList& list) const
{
    list.SetValue(kKey_NumTechInfos, static_cast<int>(mTechnologies.size()));
    std::size_t index = 0;
    for (const auto& [type, technology] : mTechnologies)
    {
        WriteTechnologyDirectories(list.GetOrCreateSubList(IndexedKey(kKey_TechInfo, index)), *technology);
        ++index;
    }
}

void PluginModuleInfoManager::LoadConfiguration(File& file)
{
    PropList list;
    unsigned int version = 0;
    if (file.Exists())
    {
        zebcore::proplist::utils::LoadPropList(file.FullPath(), list, false);
        list.GetValue(kKey_ConfigurationVersion, version);
    }
    // There is no migration: a file of another version counts as none, and the next save replaces it.
    if (version == kConfigurationVersion)
    {
        LoadCurrentConfiguration(list);
    }
    else
    {
        LoadWithoutFile();
    }
}

void PluginModuleInfoManager::LoadCurrentConfiguration(const PropList& list)
{
    ReadDirectories(list);
    mRecords->Clear();
    EnterRecords(list);
    // The private configuration comes first, so that its descriptors win over those of the file.
    AudioFilterDescriptorManager& descriptors = AudioFilterDescriptorManager::GetInstance();
    descriptors.ReadExternalComponentDescriptors(mPrivatePluginConfiguration, false);
    descriptors.ReadExternalComponentDescriptors(list, true);
    mPluginInfosChangedSignal();
}

void PluginModuleInfoManager::LoadWithoutFile()
{
    AudioFilterDescriptorManager::GetInstance().ReadExternalComponentDescriptors(mPrivatePluginConfiguration, false);
    mPluginInfosChangedSignal();
    if (mRecords->InOrder().empty())
    {
        ResetToDefaultFolders();
    }
}

void PluginModuleInfoManager::SaveConfiguration(File& file, bool withDirectories) const
{
    try
    {
        zebcore::proplist::utils::SavePropList(file, SettingsView(*this, withDirectories));
    }
    catch (const zebcore::filesupport::file_delete_exception&)
    {
        // A settings file that cannot be replaced stays; the catalogue in memory is as good as before.
    }
}

void PluginModuleInfoManager::BuildConfigurationPropList(PropList& list, bool withDirectories) const
{
    list.SetValue(kKey_ConfigurationVersion, kConfigurationVersion);
    if (withDirectories)
    {
        WriteDirectories(list);
    }
    WritePluginInfos(list);
    AudioFilterDescriptorManager::GetInstance().WriteExternalComponentDescriptors(list);
}

UTF8String PluginModuleInfoManager::GetConfigurationAsXML() const
{
    UTF8String text;
    zebcore::proplist::utils::WritePropList(text, SettingsView(*this, true));
    return text;
}

void PluginModuleInfoManager::AddConfiguration(const UTF8String& text, bool notify)
{
    PropList list;
    zebcore::proplist::utils::ReadPropList(text, list);
    EnterRecords(list);
    AudioFilterDescriptorManager::GetInstance().ReadExternalComponentDescriptors(list, true);
    if (notify)
    {
        mPluginInfosChangedSignal();
    }
}

void PluginModuleInfoManager::SetPrivatePluginConfiguration(const UTF8String& text)
{
    mPrivatePluginConfiguration.Clear();
    zebcore::proplist::utils::ReadPropList(text, mPrivatePluginConfiguration);
}

void PluginModuleInfoManager::ClearAll(bool withoutPrivate)
{
    mRecords->Clear();
    AudioFilterDescriptorManager& descriptors = AudioFilterDescriptorManager::GetInstance();
    descriptors.ClearExternalInfos();
    if (!withoutPrivate)
    {
        descriptors.ReadExternalComponentDescriptors(mPrivatePluginConfiguration, false);
    }
}

} // namespace zebaudiofilterhost
