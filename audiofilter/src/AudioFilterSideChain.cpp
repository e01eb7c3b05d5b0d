// Connecting the side chain's channels.
#include "audiofilter/AudioFilter.h"
#include "audiofilter/src/ChannelMapEditing.h"

namespace zebaudiofilterhost
{

namespace
{

// First input from `start` on that no slot has as its source, or -1.
int FirstFreeInput(const ChannelMap& map, int start, int inputs)
{
    for (int input = start; input < inputs; ++input)
    {
        if (map.Find(input) < 0)
            return input;
    }
    return -1;
}

} // namespace

int AudioFilter::FirstSideChainInput() const
{
    if (mInputBuses.size() == 2)
        return mInputBuses.front().GetChannelCount(); // The second bus is the side chain
    const int outputs = GetNumberOfOutputChannels();
    return outputs < GetNumberOfInputChannels() ? outputs : 0;
}

void AudioFilter::AutoConnectSideChainChannels(bool clearFirst)
{
    ChannelMap map = mInputChannelMap;
    const int remaining = mSideChainTargetBus.GetChannelCount();
    int next = mMainTargetBus.GetChannelCount(); // The application numbers the side chain's channels from here

    // Application numbers are looked up among plug-in channels, and plug-in inputs among sources, on purpose.
    if (clearFirst)
    {
        for (int k = 0; k < remaining; ++k)
            channelmaps::ClearSlotOfPlugChannel(map, next + k);
    }

    const int start = FirstSideChainInput();
    const int inputs = GetNumberOfInputChannels();
    for (int round = 0; round < remaining; ++round)
    {
        const int input = FirstFreeInput(map, start, inputs);
        if (input < 0)
            break;
        channelmaps::SetMapping(map, input, next);
        ++next;
    }
    SetChannelMap(map, kDirection_Input);
}

} // namespace zebaudiofilterhost
