#include "render/Routing.h"

#include "audio/ChannelNames.h"
#include "cli/Failure.h"
#include "output/PrintableText.h"
#include "output/Strings.h"

#include <algorithm>

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::AudioFilterBusDescription;
using zebmediatypes::AudioChannelLabel;
using zebmediatypes::ChannelLayout;
using zebmediatypes::ChannelMap;

namespace
{

using Buses = std::vector<AudioFilterBusDescription>;

int FirstBusChannels(const Buses& buses)
{
    return buses.empty() ? 0 : static_cast<int>(buses.front().GetChannelCount());
}

bool Fits(const AudioFilter& filter, int channels)
{
    const bool inputFits = filter.GetInputBuses().empty() || FirstBusChannels(filter.GetInputBuses()) == channels;
    return inputFits && FirstBusChannels(filter.GetOutputBuses()) == channels;
}

void Request(AudioFilter& filter, const ChannelLayout& layout, const ChannelLayout& sideChain)
{
    std::vector<ChannelLayout> inputs = {layout};
    if (!sideChain.empty())
    {
        inputs.push_back(sideChain);
    }
    filter.RequestIOConfiguration(inputs, {layout});
}

// A plug-in may refuse a layout for its labels, and a side chain for its width.
void RequestBuses(AudioFilter& filter, const ChannelLayout& wanted, const ChannelLayout& sideChain)
{
    std::vector<ChannelLayout> layouts = {wanted, UsualLayout(static_cast<int>(wanted.size()))};
    const std::vector<ChannelLayout> others = OtherLayouts(static_cast<int>(wanted.size()));
    layouts.insert(layouts.end(), others.begin(), others.end());
    std::vector<ChannelLayout> sides = {sideChain};
    if (!sideChain.empty())
    {
        sides.push_back(UsualLayout(2));
        sides.push_back(UsualLayout(1));
        sides.emplace_back();
    }
    for (const ChannelLayout& layout : layouts)
    {
        for (const ChannelLayout& side : sides)
        {
            Request(filter, layout, side);
            if (Fits(filter, static_cast<int>(wanted.size())))
            {
                return;
            }
        }
    }
}

struct SideChainPlace
{
    int firstPluginChannel = 0;
    int channels = 0;
};

// Some plug-ins have no bus for it: their inputs go on behind those that belong to the outputs.
SideChainPlace FindSideChain(const AudioFilter& filter)
{
    SideChainPlace place;
    for (const AudioFilterBusDescription& bus : filter.GetInputBuses())
    {
        place.channels = static_cast<int>(bus.GetChannelCount());
        if (bus.GetType() == AudioFilterBusDescription::kBusType_SideChain)
        {
            return place;
        }
        place.firstPluginChannel += place.channels;
    }
    const int outputs = filter.GetNumberOfOutputChannels();
    const int beyond = filter.GetNumberOfInputChannels() - outputs;
    if (filter.GetInputBuses().size() == 1 && beyond > 0 && filter.CanUseSideChaining())
    {
        return {outputs, beyond};
    }
    throw Failure(ExitCode::JobFailed, Printable(filter.GetDisplayName()) +
                                           " has no side-chain input: render without --side-chain, or choose another "
                                           "filter");
}

ChannelMap UnconnectedMap(int slots)
{
    ChannelMap map;
    for (int slot = 0; slot < slots; ++slot)
    {
        map.AddChannel({}, -1);
    }
    return map;
}

void Connect(ChannelMap& map, int pluginChannel, int slot)
{
    map.SetChannelLayout(slot, {static_cast<AudioChannelLabel>(pluginChannel)});
    map.SetChannel(slot, slot);
}

void Disconnect(ChannelMap& map, int pluginChannel)
{
    const int slot = map.GetSourceChannelIndexForChannelLabel(static_cast<AudioChannelLabel>(pluginChannel));
    if (slot >= 0)
    {
        map.SetChannelLayout(slot, {});
        map.SetChannel(slot, -1);
    }
}

// The plug-in's first bus on the row, in whichever way was asked for.
ChannelMap MapFirstBus(const Buses& buses, const RoutingRequest& request, int slots)
{
    ChannelMap map = UnconnectedMap(slots);
    if (request.on.empty())
    {
        const ChannelMap best = AudioFilter::BuildBestFitChannelMap(buses, request.file);
        for (int slot = 0; slot < std::min(best.GetNumberOfChannels(), slots); ++slot)
        {
            if (!best.GetChannelLayout(slot).empty())
            {
                Connect(map, static_cast<int>(best.GetChannelLayout(slot).front().GetLabel()), slot);
            }
        }
        return map;
    }
    const int count = std::min(FirstBusChannels(buses), static_cast<int>(request.on.size()));
    for (int channel = 0; channel < count; ++channel)
    {
        Connect(map, channel, request.on[static_cast<std::size_t>(channel)]);
    }
    return map;
}

// A single channel stands for all inputs: the padding behind it carries copies of it.
void FeedFromPadding(ChannelMap& map, const Buses& buses, const Routing& routing)
{
    int slot = routing.fileChannels;
    for (int channel = 0; routing.paddingSource >= 0 && channel < FirstBusChannels(buses); ++channel)
    {
        if (map.GetSourceChannelIndexForChannelLabel(static_cast<AudioChannelLabel>(channel)) < 0 &&
            slot < routing.mainChannels)
        {
            Connect(map, channel, slot++);
        }
    }
}

void ConnectSideChain(const AudioFilter& filter, Routing& routing)
{
    const SideChainPlace place = FindSideChain(filter);
    routing.sideChannels = std::max(place.channels, routing.sideFileChannels);
    for (int channel = 0; channel < place.channels; ++channel)
    {
        const int slot = routing.mainChannels + channel;
        while (routing.inputMap.GetNumberOfChannels() <= slot)
        {
            routing.inputMap.AddChannel({}, -1);
        }
        Disconnect(routing.inputMap, place.firstPluginChannel + channel);
        Connect(routing.inputMap, place.firstPluginChannel + channel, slot);
    }
}

ChannelLayout Row(const ChannelLayout& file, int channels)
{
    ChannelLayout row = file;
    row.resize(static_cast<std::size_t>(channels));
    return row;
}

std::vector<int> WrittenChannels(const Routing& routing)
{
    std::vector<int> written;
    for (int slot = 0; slot < routing.fileChannels; ++slot)
    {
        if (!routing.outputMap.GetChannelLayout(slot).empty())
        {
            written.push_back(slot);
        }
    }
    return written;
}

void GiveToFilter(AudioFilter& filter, const RoutingRequest& request, const Routing& routing)
{
    filter.SetUseChannelMap(true);
    filter.SetMainTargetBus(AudioFilterBusDescription(u"File", Row(request.file, routing.mainChannels),
                                                      AudioFilterBusDescription::kBusType_Main));
    filter.SetSideChainTargetBus(AudioFilterBusDescription(
        u"Side chain", Row(request.sideChain, routing.sideChannels), AudioFilterBusDescription::kBusType_SideChain));
    filter.SetChannelMap(routing.inputMap, AudioFilter::kDirection_Input);
    filter.SetChannelMap(routing.outputMap, AudioFilter::kDirection_Output);
}

void CheckWidth(const AudioFilter& filter, const RoutingRequest& request)
{
    const int outputs = FirstBusChannels(filter.GetOutputBuses());
    if (outputs == 0)
    {
        throw Failure(ExitCode::JobFailed, Printable(filter.GetDisplayName()) +
                                               " gives no sound: it has no audio output, or did not start up");
    }
    if (!request.on.empty() && static_cast<int>(request.on.size()) > outputs)
    {
        throw Failure(ExitCode::JobFailed, Printable(filter.GetDisplayName()) + " takes " +
                                               Counted(static_cast<std::size_t>(outputs), "channel") + ", not the " +
                                               std::to_string(request.on.size()) + " of --on: name fewer");
    }
}

} // namespace

Routing RouteFilter(AudioFilter& filter, const RoutingRequest& request)
{
    const ChannelLayout wanted = request.on.empty() ? request.file : UsualLayout(static_cast<int>(request.on.size()));
    RequestBuses(filter, wanted, request.sideChain);
    CheckWidth(filter, request);
    const Buses& inputs = filter.GetInputBuses();
    const Buses& outputs = filter.GetOutputBuses();
    Routing routing;
    routing.fileChannels = static_cast<int>(request.file.size());
    routing.mainChannels = std::max({routing.fileChannels, FirstBusChannels(inputs), FirstBusChannels(outputs)});
    if (wanted.size() == 1 && FirstBusChannels(inputs) > 1)
    {
        routing.paddingSource = request.on.empty() ? 0 : request.on.front();
        routing.mainChannels = std::max(routing.mainChannels, routing.fileChannels + FirstBusChannels(inputs) - 1);
    }
    routing.sideFileChannels = static_cast<int>(request.sideChain.size());
    routing.inputMap = MapFirstBus(inputs, request, routing.mainChannels);
    routing.outputMap = MapFirstBus(outputs, request, routing.mainChannels);
    FeedFromPadding(routing.inputMap, inputs, routing);
    if (!request.sideChain.empty())
    {
        ConnectSideChain(filter, routing);
    }
    routing.processed = WrittenChannels(routing);
    GiveToFilter(filter, request, routing);
    return routing;
}

} // namespace zebhost
