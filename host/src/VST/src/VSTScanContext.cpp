#include "host/src/VST/src/VSTScanContext.h"

namespace zebaudiofilterhost::vst
{

VSTScanContext::VSTScanContext() : ModuleScanContext(GetVSTPlugin)
{
}
VSTScanContext::~VSTScanContext() = default;

boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>&)
{
    return new VSTScanContext;
}

} // namespace zebaudiofilterhost::vst
