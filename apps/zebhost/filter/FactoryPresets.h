#pragma once

#include <audiofilter/AudioFilter.h>

#include <string>
#include <vector>

namespace zebhost
{

// The presets that are built into a plug-in, in its order, without those that have no name; of a count that lies, the
// first few thousand.
std::vector<std::string> FactoryPresetNames(const zebaudiofilterhost::AudioFilter& filter);

// The index of the first of that name, in any case of its letters; -1 if there is none.
int FindFactoryPreset(const zebaudiofilterhost::AudioFilter& filter, const std::string& name);

} // namespace zebhost
