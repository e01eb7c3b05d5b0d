// Start and stop of the library.
#pragma once

#include "foundation/zebcore/Export.h"

namespace zebaudiofilterhost
{

/// Starts the library; the thread of the first call, and of the first one after the last Terminate, becomes the main
/// thread. Built-in filters enter the catalogue and console commands are registered. Calls count: further ones only
/// raise the count. Always true. [main]
ZEB_EXPORT bool Initialize();

/// Takes back one Initialize; the last unregisters the console commands. Nothing else is torn down: filters, modules
/// and the catalogue live on. A call without Initialize wraps the count and does nothing else. [main]
ZEB_EXPORT void Terminate();

} // namespace zebaudiofilterhost
