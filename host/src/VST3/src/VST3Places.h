#pragma once

#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// Where this system keeps VST 3 bundles, the user's own place first. They need not exist. [main]
std::vector<Dir> GetVST3Places();

} // namespace zebaudiofilterhost::vst3
