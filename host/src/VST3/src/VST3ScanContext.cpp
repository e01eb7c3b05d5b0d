#include "host/src/VST3/src/VST3ScanContext.h"

#include "audiofilter/AudioFilter.h"
#include "foundation/zebcore/StringStreams.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"

namespace zebaudiofilterhost::vst3
{

VST3ScanContext::VST3ScanContext() = default;
VST3ScanContext::~VST3ScanContext() = default;

void VST3ScanContext::SetPluginLocators(const std::vector<PluginLocator>& locators, bool skipCategory)
{
    mLocators = locators;
    mSkipCategory = skipCategory;
    mLocatorIndex = 0;
    mInfo.reset();
    mFilterIDs.clear();
    mDescriptors.clear();
    mModule.reset();
    // mFilterIndex stays: a context that is given new bundles in the middle of one goes on at that class.
}

bool VST3ScanContext::GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const
{
    if (mLocatorIndex >= mLocators.size())
        return false;
    locator = mLocators[mLocatorIndex];
    detail.clear();
    if (mFilterIDs.size() >= 2)
    {
        zebcore::utility::oUTF16StringStream stream;
        stream << " (" << mFilterIndex + 1 << "/" << mFilterIDs.size() << ")";
        detail = stream.str();
    }
    index = mLocatorIndex;
    return true;
}

bool VST3ScanContext::Continue()
{
    if (!mModule)
        NextModule();
    if (mLocatorIndex < mLocators.size())
    {
        ProbeCurrentFilter();
        ++mFilterIndex;
        if (mFilterIndex >= mFilterIDs.size())
        {
            RegisterCurrentPluginModuleInfo();
            ++mLocatorIndex;
            mFilterIndex = 0;
        }
    }
    return mLocatorIndex < mLocators.size();
}

void VST3ScanContext::NextModule()
{
    if (mLocatorIndex >= mLocators.size())
        return;
    const boost::intrusive_ptr<VST3PluginModule> module = GetVST3Plugin(mLocators[mLocatorIndex].GetPath());
    if (module)
    {
        mFilterIDs.clear();
        mInfo = module->GetPluginInfo(mFilterIDs);
    }
    mModule = module;
}

void VST3ScanContext::ProbeCurrentFilter()
{
    if (mFilterIndex >= mFilterIDs.size() || !mModule)
        return;
    const boost::intrusive_ptr<AudioFilter> filter = mModule->CreateAudioFilter(mFilterIDs[mFilterIndex]);
    if (!filter)
        return;
    const auto descriptor = filter->CreateFilterDescriptor(mLocators[mLocatorIndex], mSkipCategory);
    if (descriptor && !descriptor->IsSynth())
        mDescriptors.push_back(descriptor);
}

void VST3ScanContext::RegisterCurrentPluginModuleInfo()
{
    if (mInfo)
    {
        mInfo->SetHasAnyNonSynthEffect(!mDescriptors.empty());
        PluginModuleInfoManager::GetInstance().AddPluginModuleInfo(mInfo);
        for (const auto& descriptor : mDescriptors)
            AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(descriptor);
        mInfo.reset();
    }
    mFilterIDs.clear();
    mDescriptors.clear();
    mModule.reset();
}

boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>&)
{
    return new VST3ScanContext;
}

} // namespace zebaudiofilterhost::vst3
