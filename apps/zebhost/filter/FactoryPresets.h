#pragma once

#include <audiofilter/AudioFilter.h>

#include <string>
#include <vector>

namespace zebhost
{

// The presets that are built into a plug-in, by index; of a count that lies, the first few thousand.
std::vector<std::string> FactoryPresetNames(const zebaudiofilterhost::AudioFilter& filter);

} // namespace zebhost
