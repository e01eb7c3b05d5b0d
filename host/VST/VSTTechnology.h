#pragma once

#include "foundation/zebcore/Export.h"
#include "utility/CommonTypes.h"

namespace zebaudiofilterhost::vst
{

// The GUID under which AudioFilterFactory knows all VST 2 filters. [any]
ZEB_EXPORT Guid GetVSTFactoryGuid();

// The application's own VST 2 plug-ins: "Plug-Ins/VST" below the application's folder, whether it exists or not.
// No scan looks there by itself. [main]
ZEB_EXPORT UTF16String GetPrivateVSTPluginDirectory();

} // namespace zebaudiofilterhost::vst
