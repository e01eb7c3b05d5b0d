// How connections are written into a channel map.
#pragma once

#include "audiofilter/AudioFilterBusDescription.h"
#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost::channelmaps
{

/// A plug-in channel number in the form in which a slot's layout holds it.
AudioChannelLabel LabelOf(int plugChannel);

/// Connects a slot to a plug-in channel; the map grows up to the slot, which must not be negative.
void SetMapping(ChannelMap& map, int plugChannel, int slot);

/// Empties the slot's layout and its source. A slot that is not there is ignored.
void ClearSlot(ChannelMap& map, int slot);

/// Clears the slot that carries this plug-in channel, if there is one.
void ClearSlotOfPlugChannel(ChannelMap& map, int plugChannel);

/// Replaces the map by `count` slots whose source is their own index; with `connect` the identity.
void CreateEmptyChannelMap(int count, bool connect, ChannelMap& map);

/// Sum of the buses' channels.
int CountChannels(const std::vector<AudioFilterBusDescription>& buses);

} // namespace zebaudiofilterhost::channelmaps
