#pragma once

#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost::vst
{

/// Where this system keeps VST 2 plug-ins, the machine's own places first. They need not exist. [main]
std::vector<Dir> GetVSTPlaces();

} // namespace zebaudiofilterhost::vst
