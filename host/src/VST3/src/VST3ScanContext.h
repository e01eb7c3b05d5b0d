#pragma once

#include "host/AudioFilterDescriptor.h"
#include "host/PluginModuleInfo.h"
#include "host/PluginScanContext.h"
#include "host/src/VST3/src/VST3PluginModule.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// Steps through VST 3 bundles, one class a step. What a bundle holds enters the catalogue when all its classes have
/// been seen; what was found of a bundle in progress goes with the context. Instruments are left out. [main]
class VST3ScanContext : public PluginScanContext
{
public:
    VST3ScanContext();
    ~VST3ScanContext() override;

    void SetPluginLocators(const std::vector<PluginLocator>& locators, bool skipCategory) override;
    bool GetCurrentProgressInfo(PluginLocator& locator, UTF16String& detail, unsigned long& index) const override;
    bool Continue() override;

private:
    void NextModule();
    void ProbeCurrentFilter();
    void RegisterCurrentPluginModuleInfo();

    std::vector<PluginLocator> mLocators;
    bool mSkipCategory = false;
    unsigned long mLocatorIndex = 0;
    boost::intrusive_ptr<VST3PluginModule> mModule; // null between bundles
    boost::intrusive_ptr<PluginModuleInfo> mInfo;   // not registered yet
    std::vector<UTF16String> mFilterIDs;
    std::vector<boost::intrusive_ptr<AudioFilterDescriptor>> mDescriptors;
    unsigned long mFilterIndex = 0;
};

/// The directories are ignored. [main]
boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>& directories);

} // namespace zebaudiofilterhost::vst3
