#include "host/PluginScanContext.h"

namespace zebaudiofilterhost
{

PluginScanContext::~PluginScanContext() = default;

} // namespace zebaudiofilterhost
