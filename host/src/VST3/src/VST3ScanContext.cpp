#include "host/src/VST3/src/VST3ScanContext.h"

namespace zebaudiofilterhost::vst3
{

VST3ScanContext::VST3ScanContext() : ModuleScanContext(GetVST3Plugin)
{
}
VST3ScanContext::~VST3ScanContext() = default;

boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>&)
{
    return new VST3ScanContext;
}

} // namespace zebaudiofilterhost::vst3
