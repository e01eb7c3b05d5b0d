#include "host/src/XAU/src/XAUScanContext.h"

#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfo.h"
#include "host/PluginModuleInfoManager.h"
#include "host/src/XAU/src/XAUAudioFilter.h"

namespace zebaudiofilterhost::xau
{

namespace
{

void Scan(const PluginLocator& locator)
{
    const UTF16String id = locator.GetPath();
    if (BannedPluginManager::GetInstance().IsPluginBannedStatically(id, id, UTF16String()))
        return;
    std::vector<boost::intrusive_ptr<AudioFilterDescriptor>> descriptors;
    const auto info = XAUAudioFilter::EnumerateFilters(locator, 0, 0, descriptors);
    if (!info || descriptors.empty())
        return;
    info->SetHasAnyNonSynthEffect(true);
    PluginModuleInfoManager::GetInstance().AddPluginModuleInfo(info);
    for (const auto& descriptor : descriptors)
        AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(descriptor);
}

} // namespace

// Units of this technology have no category, so there is none to skip.
void XAUScanContext::SetPluginLocators(const std::vector<PluginLocator>& locators, bool /*skipCategory*/)
{
    mLocators = locators;
    mLocatorIndex = 0;
}

bool XAUScanContext::GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const
{
    if (mLocatorIndex >= mLocators.size())
        return false;
    locator = mLocators[mLocatorIndex];
    detail.clear();
    index = mLocatorIndex;
    return true;
}

bool XAUScanContext::Continue()
{
    if (mLocatorIndex >= mLocators.size())
        return false;
    Scan(mLocators[mLocatorIndex]);
    ++mLocatorIndex;
    return mLocatorIndex < mLocators.size();
}

} // namespace zebaudiofilterhost::xau
