#pragma once

#include "foundation/zebcore/Export.h"
#include "utility/CommonTypes.h"

namespace zebaudiofilterhost::vst3
{

// The GUID under which AudioFilterFactory knows all VST 3 filters. [any]
ZEB_EXPORT Guid GetVST3FactoryGuid();

// The application's own VST 3 plug-ins: "Plug-Ins/VST3" below the application's folder, whether it exists or not.
// No scan looks there by itself. [main]
ZEB_EXPORT UTF16String GetPrivateVST3PluginDirectory();

} // namespace zebaudiofilterhost::vst3
