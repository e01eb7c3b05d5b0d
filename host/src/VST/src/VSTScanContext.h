#pragma once

#include "host/src/ModuleScanContext.h"
#include "host/src/VST/src/VSTPluginModule.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost::vst
{

/// Steps through VST 2 binaries, one effect of one binary a step. [main]
class VSTScanContext : public ModuleScanContext<VSTPluginModule>
{
public:
    VSTScanContext();
    ~VSTScanContext() override;
};

/// The directories are ignored. [main]
boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>& directories);

} // namespace zebaudiofilterhost::vst
