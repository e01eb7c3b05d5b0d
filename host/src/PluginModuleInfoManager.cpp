#include "host/PluginModuleInfoManager.h"

#include "host/AudioFilterDescriptorManager.h"

#include <algorithm>
#include <set>
#include <utility>

namespace zebaudiofilterhost
{

PluginModuleInfoManager& PluginModuleInfoManager::GetInstance()
{
    static PluginModuleInfoManager sInstance;
    return sInstance;
}

PluginModuleInfoManager::PluginModuleInfoManager() : mSettingsFileName(u"AudioPluginManagerSettings.xml")
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
    const auto known = mInfos.find(info->GetLocator());
    if (known != mInfos.end())
    {
        // The map and the vector hold the same objects, so the pointer finds the entry of the locator.
        mInfosInOrder.erase(std::find(mInfosInOrder.begin(), mInfosInOrder.end(), known->second));
        mInfos.erase(known);
    }
    mInfos.emplace(info->GetLocator(), info);
    mInfosInOrder.push_back(std::move(info));
    mPluginInfosChangedSignal();
}

PluginModuleInfoManager::PluginInfoIterator PluginModuleInfoManager::PluginInfoBegin() const
{
    return mInfosInOrder.begin();
}

PluginModuleInfoManager::PluginInfoIterator PluginModuleInfoManager::PluginInfoEnd() const
{
    return mInfosInOrder.end();
}

PluginModuleInfoManager::PluginInfosChangedSignal& PluginModuleInfoManager::GetPluginInfosChangedSignal()
{
    return mPluginInfosChangedSignal;
}

PluginModuleInfoManager::PluginInfoPtr PluginModuleInfoManager::FindPluginInfo(const PluginLocator& locator) const
{
    const auto found = mInfos.find(locator);
    return found == mInfos.end() ? PluginInfoPtr() : found->second;
}

std::vector<PluginLocator> PluginModuleInfoManager::GetPluginLocators() const
{
    std::vector<PluginLocator> locators;
    for (const auto& [locator, info] : mInfos)
    {
        locators.push_back(locator);
    }
    return locators;
}

std::vector<PluginLocator> PluginModuleInfoManager::GetEnabledPlugins() const
{
    std::vector<PluginLocator> locators;
    for (const auto& [locator, info] : mInfos)
    {
        if (info->IsEnabled())
        {
            locators.push_back(locator);
        }
    }
    return locators;
}

bool PluginModuleInfoManager::IsPluginEnabled(const PluginLocator& locator, bool unknownIsDisabled) const
{
    const auto found = mInfos.find(locator);
    return found == mInfos.end() ? !unknownIsDisabled : found->second->IsEnabled();
}

void PluginModuleInfoManager::SetPluginEnabled(const PluginLocator& locator, bool enabled)
{
    const auto found = mInfos.find(locator);
    if (found != mInfos.end())
    {
        found->second->SetEnabled(enabled);
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
    std::vector<PluginLocator> gone;
    for (const auto& [locator, info] : mInfos)
    {
        if (!onDisk.contains(locator))
        {
            gone.push_back(locator);
        }
    }
    removed.swap(gone);

    if (onlyNew)
    {
        std::erase_if(found, [this](const PluginLocator& locator) { return mInfos.contains(locator); });
    }
    return found;
}

void PluginModuleInfoManager::RemovePluginLocators(const std::vector<PluginLocator>& locators)
{
    std::vector<PluginLocator> removed;
    std::set<PluginInfoPtr> removedInfos;
    for (const PluginLocator& locator : locators)
    {
        const auto found = mInfos.find(locator);
        if (found != mInfos.end())
        {
            removedInfos.insert(found->second);
            removed.push_back(found->first);
            mInfos.erase(found);
        }
    }
    if (removed.empty())
    {
        return;
    }
    std::erase_if(mInfosInOrder, [&removedInfos](const PluginInfoPtr& info) { return removedInfos.contains(info); });
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
