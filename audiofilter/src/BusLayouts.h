#pragma once

#include "audiofilter/AudioFilterBusDescription.h"

#include <vector>

namespace zebaudiofilterhost
{

// The buses' channel layouts, in the order of the buses.
inline std::vector<zebmediatypes::ChannelLayout> LayoutsOf(const std::vector<AudioFilterBusDescription>& buses)
{
    std::vector<zebmediatypes::ChannelLayout> layouts;
    layouts.reserve(buses.size());
    for (const AudioFilterBusDescription& bus : buses)
    {
        layouts.push_back(bus.GetLayout());
    }
    return layouts;
}

} // namespace zebaudiofilterhost
