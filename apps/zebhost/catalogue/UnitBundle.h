#pragma once

#include <host/PluginLocator.h>

#include <filesystem>
#include <vector>

namespace zebhost
{

// The units of an Audio Unit bundle that are effects, mixers or panners: a locator for each, in the order of the
// bundle's Info.plist; none if that can't be read. On Linux this process, and those that it starts, can then load
// them, wherever the bundle lies.
std::vector<zebaudiofilterhost::PluginLocator> UnitsOf(const std::filesystem::path& bundle);

} // namespace zebhost
