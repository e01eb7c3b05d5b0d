#include "examples/effects/support/BusSet.h"

#include "examples/effects/support/Text.h"

#include <algorithm>
#include <bit>

namespace effects
{

int32 ChannelCount(SpeakerArrangement arrangement)
{
    return std::popcount(arrangement);
}

BusSet::BusSet(std::vector<Bus> inputs, std::vector<Bus> outputs)
    : mInputs(std::move(inputs)), mOutputs(std::move(outputs))
{
}

int32 BusSet::Count(MediaType media, BusDirection direction) const
{
    const auto& list = List(direction);
    return static_cast<int32>(std::count_if(list.begin(), list.end(), [=](auto& bus) { return bus.media == media; }));
}

const Bus* BusSet::Find(MediaType media, BusDirection direction, int32 index) const
{
    for (const Bus& bus : List(direction))
        if (bus.media == media && index-- == 0)
            return &bus;
    return nullptr;
}

tresult BusSet::GetInfo(MediaType media, BusDirection direction, int32 index, BusInfo& info) const
{
    const Bus* bus = Find(media, direction, index);
    if (bus == nullptr)
        return kInvalidArgument;
    info = {};
    info.mediaType = media;
    info.direction = direction;
    info.channelCount = media == kAudio ? ChannelCount(bus->arrangement) : 16; // MIDI channels
    CopyText(bus->name, info.name);
    info.busType = bus->type;
    info.flags = bus->type == kMain ? static_cast<uint32>(BusInfo::kDefaultActive) : 0;
    return kResultOk;
}

tresult BusSet::Activate(MediaType media, BusDirection direction, int32 index, bool active)
{
    const Bus* bus = Find(media, direction, index);
    if (bus == nullptr)
        return kInvalidArgument;
    auto& list = List(direction);
    list[static_cast<std::size_t>(bus - list.data())].active = active;
    return kResultOk;
}

SpeakerArrangement BusSet::Arrangement(BusDirection direction, int32 index) const
{
    const Bus* bus = Find(kAudio, direction, index);
    return bus != nullptr ? bus->arrangement : SpeakerArr::kEmpty;
}

void BusSet::SetArrangement(BusDirection direction, int32 index, SpeakerArrangement arrangement)
{
    auto& list = List(direction);
    if (const Bus* bus = Find(kAudio, direction, index))
        list[static_cast<std::size_t>(bus - list.data())].arrangement = arrangement;
}

} // namespace effects
