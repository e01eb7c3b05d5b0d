#pragma once

#include "host/PluginLocator.h"
#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost::vst
{

/// The plug-ins below a directory, without those that the dynamic block list names: directories whose path ends in
/// ".vst", which are not entered, and what else this system takes for a plug-in. Walked depth-first, last-found
/// directory first. [main]
std::vector<PluginLocator> GetPotentialPluginLocators(const Dir& directory);

/// Where the technology looks unless it is told otherwise. [main]
std::vector<UTF16String> GetDefaultVSTPluginDirectories();

/// The path as it is. [any]
UTF16String GetPathDisplayString(const UTF16String& path);

} // namespace zebaudiofilterhost::vst
