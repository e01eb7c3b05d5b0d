#pragma once

#include "host/src/ModuleScanContext.h"
#include "host/src/VST3/src/VST3PluginModule.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// Steps through VST 3 bundles, one class a step. [main]
class VST3ScanContext : public ModuleScanContext<VST3PluginModule>
{
public:
    VST3ScanContext();
    ~VST3ScanContext() override;
};

/// The directories are ignored. [main]
boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>& directories);

} // namespace zebaudiofilterhost::vst3
