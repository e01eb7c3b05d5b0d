#include "host/PluginModuleInfoManager.h"

#include "host/AudioFilterDescriptorManager.h"
#include "host/src/PluginModuleRecords.h"

#include <algorithm>
#include <iterator>
#include <set>
#include <utility>

namespace zebaudiofilterhost
{

PluginModuleInfoManager& PluginModuleInfoManager::GetInstance()
{
    static PluginModuleInfoManager sInstance;
    return sInstance;
}

PluginModuleInfoManager::PluginModuleInfoManager()
    : mRecords(std::make_unique<PluginModuleRecords>()), mSettingsFileName(u"AudioPluginManagerSettings.xml")
{
}

PluginModuleInfoManager::~PluginModuleInfoManager() = default;

void PluginModuleInfoManager::AddPluginTechnology(TechnologyPtr technology)
{
    if (technology)
    {
        const TechnologyType type = technology->GetType();
        mTechnologies.emplace(type, std::move(technology));
    }
}

PluginModuleInfoManager::TechnologyPtr PluginModuleInfoManager::GetPluginTechnology(TechnologyType type) const
{
    const auto found = mTechnologies.find(type);
    return found == mTechnologies.end() ? TechnologyPtr() : found->second;
}

std::vector<PluginModuleInfoManager::TechnologyPtr> PluginModuleInfoManager::GetPluginTechnologies() const
{
    std::vector<TechnologyPtr> technologies;
    for (const auto& [type, technology] : mTechnologies)
    {
        technologies.push_back(technology);
    }
    return technologies;
}

void PluginModuleInfoManager::AddPluginModuleInfo(PluginInfoPtr info)
{
    if (!info)
    {
        return;
    }
    mRecords->Add(std::move(info));
    mPluginInfosChangedSignal();
}

PluginModuleInfoManager::PluginInfoIterator PluginModuleInfoManager::PluginInfoBegin() const
{
    return mRecords->InOrder().begin();
}

PluginModuleInfoManager::PluginInfoIterator PluginModuleInfoManager::PluginInfoEnd() const
{
    return mRecords->InOrder().end();
}

PluginModuleInfoManager::PluginInfosChangedSignal& PluginModuleInfoManager::GetPluginInfosChangedSignal()
{
    return mPluginInfosChangedSignal;
}

PluginModuleInfoManager::PluginInfoPtr PluginModuleInfoManager::FindPluginInfo(const PluginLocator& locator) const
{
    return mRecords->Find(locator);
}

std::vector<PluginLocator> PluginModuleInfoManager::GetPluginLocators() const
{
    return mRecords->Locators();
}

std::vector<PluginLocator> PluginModuleInfoManager::GetEnabledPlugins() const
{
    std::vector<PluginLocator> locators;
    for (const PluginInfoPtr& info : mRecords->InOrder())
    {
        if (info->IsEnabled())
        {
            locators.push_back(info->GetLocator());
        }
    }
    std::sort(locators.begin(), locators.end());
    return locators;
}

bool PluginModuleInfoManager::IsPluginEnabled(const PluginLocator& locator, bool unknownIsDisabled) const
{
    const PluginInfoPtr info = FindPluginInfo(locator);
    return info ? info->IsEnabled() : !unknownIsDisabled;
}

// NOLINTNEXTLINE(readability-make-member-function-const): changes a record of the catalogue
void PluginModuleInfoManager::SetPluginEnabled(const PluginLocator& locator, bool enabled)
{
    if (const PluginInfoPtr info = FindPluginInfo(locator))
    {
        info->SetEnabled(enabled);
    }
}

void PluginModuleInfoManager::ResetToDefaultFolders() const
{
    for (const TechnologyPtr& technology : GetPluginTechnologies())
    {
        technology->ResetDirectoriesToDefault();
    }
}

std::vector<PluginLocator> PluginModuleInfoManager::CollectPotentialPlugins(bool onlyNew,
                                                                            std::vector<PluginLocator>& removed) const
{
    std::vector<PluginLocator> found;
    for (const TechnologyPtr& technology : GetPluginTechnologies())
    {
        const std::vector<PluginLocator> plugins = technology->CollectPlugins();
        found.insert(found.end(), plugins.begin(), plugins.end());
    }

    const std::set<PluginLocator> onDisk(found.begin(), found.end());
    std::vector<PluginLocator> gone = mRecords->Locators();
    std::erase_if(gone, [&onDisk](const PluginLocator& locator) { return onDisk.contains(locator); });
    removed.swap(gone);

    if (onlyNew)
    {
        std::erase_if(found, [this](const PluginLocator& locator) { return mRecords->Find(locator) != nullptr; });
    }
    return found;
}

void PluginModuleInfoManager::RemovePluginLocators(const std::vector<PluginLocator>& locators)
{
    std::vector<PluginLocator> removed;
    std::copy_if(locators.begin(), locators.end(), std::back_inserter(removed),
                 [this](const PluginLocator& locator) { return mRecords->Remove(locator); });
    if (removed.empty())
    {
        return;
    }
    AudioFilterDescriptorManager::GetInstance().ClearInfosForLocators(removed);
    mPluginInfosChangedSignal();
}

UTF16String PluginModuleInfoManager::GetDisplayStringForLocator(const PluginLocator& locator) const
{
    UTF16String text;
    if (const TechnologyPtr technology = GetPluginTechnology(locator.GetTechnologyType()))
    {
        text = technology->GetPathDisplayString(locator.GetPath());
    }
    return text.empty() ? locator.GetPath() : text;
}

void PluginModuleInfoManager::SetSettingsFileName(const UTF16String& name)
{
    mSettingsFileName = name;
}

UTF16String PluginModuleInfoManager::GetSettingsFileName() const
{
    return mSettingsFileName;
}

} // namespace zebaudiofilterhost
