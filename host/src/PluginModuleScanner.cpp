#include "host/PluginModuleScanner.h"

#include "host/PluginModuleInfoManager.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace zebaudiofilterhost
{

namespace
{

std::vector<PluginLocator> LocatorsOfType(const std::vector<PluginLocator>& locators, TechnologyType type)
{
    std::vector<PluginLocator> picked;
    std::copy_if(locators.begin(), locators.end(), std::back_inserter(picked),
                 [type](const PluginLocator& locator) { return locator.GetTechnologyType() == type; });
    return picked;
}

} // namespace

PluginModuleScanner::PluginModuleScanner(const std::vector<PluginLocator>& locators, bool skipCategory)
    : mSkipCategory(skipCategory), mEnabledBefore(PluginModuleInfoManager::GetInstance().GetEnabledPlugins())
{
    for (const boost::intrusive_ptr<PluginTechnology>& technology :
         PluginModuleInfoManager::GetInstance().GetPluginTechnologies())
    {
        ScanItem item{technology, technology->CreateScanContext()};
        const std::vector<PluginLocator> picked = LocatorsOfType(locators, technology->GetType());
        if (!picked.empty())
        {
            item.context->SetPluginLocators(picked, mSkipCategory);
            item.count = picked.size();
            mTotal += item.count;
            mItems.push_back(std::move(item));
        }
    }
}

PluginModuleScanner::~PluginModuleScanner() = default;

void PluginModuleScanner::BeginScan()
{
    mCurrentItem = 0;
}

bool PluginModuleScanner::GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, int& current,
                                                 int& total) const
{
    if (mCurrentItem >= mItems.size())
    {
        return false;
    }
    unsigned long index = 0;
    const bool remains = mItems[mCurrentItem].context->GetCurrentProgressInfo(locator, detail, index);
    current = static_cast<int>(index + mItemsDone + 1);
    total = static_cast<int>(mTotal);
    return remains || mCurrentItem + 1 < mItems.size();
}

bool PluginModuleScanner::ContinueScan()
{
    while (mCurrentItem < mItems.size())
    {
        if (mItems[mCurrentItem].context->Continue())
        {
            return mCurrentItem < mItems.size();
        }
        mItemsDone += mItems[mCurrentItem].count;
        ++mCurrentItem;
    }
    return false;
}

void PluginModuleScanner::EndScan()
{
    for (const PluginLocator& locator : mEnabledBefore)
    {
        PluginModuleInfoManager::GetInstance().SetPluginEnabled(locator, true);
    }
}

} // namespace zebaudiofilterhost
