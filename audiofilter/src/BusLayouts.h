#pragma once

#include "audiofilter/AudioFilter.h"
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

// Asks `filter` for buses like these. Some plug-ins take nothing but one layout for each side, whatever they have:
// these get the first of each, or they would stay without any bus.
inline void RequestBuses(AudioFilter& filter, const std::vector<AudioFilterBusDescription>& inputs,
                         const std::vector<AudioFilterBusDescription>& outputs)
{
    filter.RequestIOConfiguration(LayoutsOf(inputs), LayoutsOf(outputs));
    const bool hasBuses = !filter.GetInputBuses().empty() || !filter.GetOutputBuses().empty();
    if (hasBuses || (inputs.empty() && outputs.empty()))
        return;
    filter.RequestIOConfiguration({(inputs.empty() ? outputs : inputs).front().GetLayout()},
                                  {(outputs.empty() ? inputs : outputs).front().GetLayout()});
}

} // namespace zebaudiofilterhost
