#pragma once

#include "foundation/zebcore/OSModule.h"

#include <string>

namespace zebcore::utility::platform
{

// The platform's side of OSModule.h. Paths are as the system takes them, also inside the texts. failure receives a
// sentence that names the file.

/// Empty on failure.
std::string FindBinary(const std::string& path, std::string& failure);
/// Null on failure. path: of the bundle or file; binary: what FindBinary gave for it.
void* OpenModule(const std::string& path, const std::string& binary, std::string& failure);
void CloseModule(void* handle);
/// Null when there is no such symbol.
ModuleFunction FindFunction(void* handle, const std::string& name);

} // namespace zebcore::utility::platform
