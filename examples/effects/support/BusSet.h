#pragma once

#include "examples/effects/support/Vst3.h"

#include <vector>

namespace effects
{

int32 ChannelCount(SpeakerArrangement arrangement);

struct Bus
{
    const char16_t* name = nullptr;
    SpeakerArrangement arrangement = 0; // 0 for an event bus
    BusType type = kMain;
    MediaType media = kAudio;
    bool active = false;
};

// The buses of one effect. Aux buses, which take a side-chain, start switched off, as all others do, and aren't
// announced as active by default.
class BusSet
{
public:
    BusSet(std::vector<Bus> inputs, std::vector<Bus> outputs);

    int32 Count(MediaType media, BusDirection direction) const;
    const Bus* Find(MediaType media, BusDirection direction, int32 index) const; // null beyond the end
    tresult GetInfo(MediaType media, BusDirection direction, int32 index, BusInfo& info) const;
    tresult Activate(MediaType media, BusDirection direction, int32 index, bool active);

    SpeakerArrangement Arrangement(BusDirection direction, int32 index) const; // 0 beyond the end
    void SetArrangement(BusDirection direction, int32 index, SpeakerArrangement arrangement);

private:
    std::vector<Bus>& List(BusDirection direction) { return direction == kInput ? mInputs : mOutputs; }
    const std::vector<Bus>& List(BusDirection direction) const { return direction == kInput ? mInputs : mOutputs; }

    std::vector<Bus> mInputs;
    std::vector<Bus> mOutputs;
};

} // namespace effects
