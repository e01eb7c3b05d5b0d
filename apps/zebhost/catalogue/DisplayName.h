#pragma once

#include <string>

namespace zebaudiofilterhost
{
class AudioFilterDescriptor;
}

namespace zebhost
{

// How a filter is called towards the user; one without a name is called like its bundle.
std::string DisplayName(const zebaudiofilterhost::AudioFilterDescriptor& descriptor);

} // namespace zebhost
