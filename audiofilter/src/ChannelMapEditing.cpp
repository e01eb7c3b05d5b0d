#include "audiofilter/src/ChannelMapEditing.h"

namespace zebaudiofilterhost::channelmaps
{

AudioChannelLabel LabelOf(int plugChannel)
{
    return static_cast<AudioChannelLabel>(plugChannel);
}

void SetMapping(ChannelMap& map, int plugChannel, int slot)
{
    while (map.GetNumberOfChannels() <= slot)
        map.AddChannel(ChannelLayout(), -1);
    map.SetChannelLayout(slot, ChannelLayout(1, AudioChannelDescription(LabelOf(plugChannel))));
    map.SetChannel(slot, slot);
}

void ClearSlot(ChannelMap& map, int slot)
{
    map.SetChannelLayout(slot, ChannelLayout());
    map.SetChannel(slot, -1);
}

void ClearSlotOfPlugChannel(ChannelMap& map, int plugChannel)
{
    ClearSlot(map, map.GetSourceChannelIndexForChannelLabel(LabelOf(plugChannel)));
}

void CreateEmptyChannelMap(int count, bool connect, ChannelMap& map)
{
    map = ChannelMap();
    for (int i = 0; map.GetNumberOfChannels() < count; ++i)
    {
        map.AddChannel(ChannelLayout(), i);
        if (connect)
            SetMapping(map, i, i);
    }
}

int CountChannels(const std::vector<AudioFilterBusDescription>& buses)
{
    int count = 0;
    for (const AudioFilterBusDescription& bus : buses)
        count += bus.GetChannelCount();
    return count;
}

} // namespace zebaudiofilterhost::channelmaps
