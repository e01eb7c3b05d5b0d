#pragma once

#include "catalogue/Catalogue.h"
#include "output/JsonDocument.h"

#include <audiofilter/AudioFilter.h>

namespace zebhost
{

// "id", "name", "vendor", "category", "version", "path", "technology", "mono", "stereo".
Json DescriptorJson(const zebaudiofilterhost::AudioFilterDescriptor& descriptor);

// "VST 3" for people.
std::string TechnologyName(const zebaudiofilterhost::AudioFilterDescriptor& descriptor);

} // namespace zebhost
