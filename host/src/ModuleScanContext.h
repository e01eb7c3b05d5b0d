#pragma once

#include "audiofilter/AudioFilter.h"
#include "foundation/zebcore/StringStreams.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfo.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginScanContext.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost
{

/// Steps through the binaries of a technology, one filter a step. What a binary holds enters the catalogue when all
/// its filters have been seen; what was found of a binary in progress goes with the context. Instruments are left
/// out. Module has GetPluginInfo and CreateAudioFilter as VST3PluginModule has them. [main]
template <class Module>
class ModuleScanContext : public PluginScanContext
{
public:
    /// Gives the loaded module of a path, or null.
    using FindModule = boost::intrusive_ptr<Module> (*)(const UTF16String& path);

    explicit ModuleScanContext(FindModule findModule) : mFindModule(findModule) {}

    void SetPluginLocators(const std::vector<PluginLocator>& locators, bool skipCategory) override
    {
        mLocators = locators;
        mSkipCategory = skipCategory;
        mLocatorIndex = 0;
        mInfo.reset();
        mFilterIDs.clear();
        mDescriptors.clear();
        mModule.reset();
        // mFilterIndex stays: a context that is given new binaries in the middle of one goes on at that filter.
    }

    bool GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const override
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

    bool Continue() override
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

private:
    void NextModule()
    {
        if (mLocatorIndex >= mLocators.size())
            return;
        const boost::intrusive_ptr<Module> module = mFindModule(mLocators[mLocatorIndex].GetPath());
        if (module)
        {
            mFilterIDs.clear();
            mInfo = module->GetPluginInfo(mFilterIDs);
        }
        mModule = module;
    }

    void ProbeCurrentFilter()
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

    void RegisterCurrentPluginModuleInfo()
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

    FindModule mFindModule;
    std::vector<PluginLocator> mLocators;
    bool mSkipCategory = false;
    unsigned long mLocatorIndex = 0;
    boost::intrusive_ptr<Module> mModule;         // null between binaries
    boost::intrusive_ptr<PluginModuleInfo> mInfo; // not registered yet
    std::vector<UTF16String> mFilterIDs;
    std::vector<boost::intrusive_ptr<AudioFilterDescriptor>> mDescriptors;
    unsigned long mFilterIndex = 0;
};

} // namespace zebaudiofilterhost
