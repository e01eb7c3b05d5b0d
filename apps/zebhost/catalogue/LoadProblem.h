#pragma once

#include <host/PluginLocator.h>

#include <string>

namespace zebhost
{

// Why the last attempt to load a plug-in failed: a sentence that names the file, without a full stop.
std::string LoadProblem(const zebaudiofilterhost::PluginLocator& locator);

} // namespace zebhost
