#pragma once

#include "host/PluginLocator.h"
#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// The bundles in the places of GetVST3Places, without those that the dynamic block list names. Each place is walked
/// depth-first, last-found directory first. The directory is ignored: VST 3 plug-ins are in fixed places. [main]
std::vector<PluginLocator> GetPotentialPluginLocators(const Dir& directory);

/// Always empty, since there is no list of directories. [any]
std::vector<UTF16String> GetDefaultVST3PluginDirectories();

/// The path as it is. [any]
UTF16String GetPathDisplayString(const UTF16String& path);

} // namespace zebaudiofilterhost::vst3
