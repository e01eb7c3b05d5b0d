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

// Whether a search would take what lies at this path for a VST 2 plug-in: a directory that ends in ".vst", or on
// Linux a file that ends in ".so" and exports an entry point. Reads the file and loads nothing. [main]
ZEB_EXPORT bool IsVSTPlugin(const UTF16String& path);

} // namespace zebaudiofilterhost::vst
