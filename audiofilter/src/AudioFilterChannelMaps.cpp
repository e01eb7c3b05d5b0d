// Which application channel talks to which plug-in channel.
#include "audiofilter/AudioFilter.h"
#include "audiofilter/src/ChannelMapEditing.h"

#include <boost/thread/locks.hpp>

#include <algorithm>

namespace zebaudiofilterhost
{

using MapLock = boost::unique_lock<boost::recursive_mutex>;

ChannelMap& AudioFilter::MapOf(Direction direction)
{
    return direction == kDirection_Input ? mInputChannelMap : mOutputChannelMap;
}

const ChannelMap& AudioFilter::MapOf(Direction direction) const
{
    return direction == kDirection_Input ? mInputChannelMap : mOutputChannelMap;
}

// Called without the lock, so that a slot may call back.
void AudioFilter::PublishMapChange(Direction direction, const ChannelMap& oldMap)
{
    if (!mSuspended.load(std::memory_order_relaxed))
        UpdateChannelMapArraysForRendering();
    mChannelMapChangedSignal(direction, oldMap, MapOf(direction));
}

void AudioFilter::SetChannelMap(const ChannelMap& map, Direction direction)
{
    const ChannelMap oldMap = MapOf(direction);
    {
        const MapLock lock(mChannelMapMutex);
        MapOf(direction) = map;
    }
    PublishMapChange(direction, oldMap);
}

ChannelMap AudioFilter::GetChannelMap(Direction direction) const
{
    const MapLock lock(mChannelMapMutex);
    return MapOf(direction);
}

void AudioFilter::AssignChannelMapping(Direction direction, int plugChannel, int slot)
{
    const ChannelMap oldMap = MapOf(direction);
    {
        const MapLock lock(mChannelMapMutex);
        ChannelMap& map = MapOf(direction);
        if (plugChannel < 0)
            map.SetChannelLayout(slot, ChannelLayout()); // The source stays: the slot counts as known, not as cleared
        else if (slot >= 0)
        {
            channelmaps::ClearSlotOfPlugChannel(map, plugChannel);
            channelmaps::SetMapping(map, plugChannel, slot);
        }
    }
    PublishMapChange(direction, oldMap);
}

void AudioFilter::RemoveChannelMapping(Direction direction, int plugChannel)
{
    const ChannelMap oldMap = MapOf(direction);
    {
        const MapLock lock(mChannelMapMutex);
        channelmaps::ClearSlotOfPlugChannel(MapOf(direction), plugChannel);
    }
    PublishMapChange(direction, oldMap);
}

void AudioFilter::SetUseChannelMap(bool use)
{
    mUseChannelMap.store(use, std::memory_order_relaxed);
}

bool AudioFilter::GetUseChannelMap() const
{
    return mUseChannelMap.load(std::memory_order_relaxed);
}

bool AudioFilter::IsChannelMapDefault(Direction direction) const
{
    const int count = direction == kDirection_Input ? GetNumberOfInputChannels() : GetNumberOfOutputChannels();
    return MapOf(direction) == ChannelMap(count);
}

void AudioFilter::SetDefaultChannelMap(Direction direction)
{
    int pluginChannels = GetNumberOfOutputChannels();
    int available = mMainTargetBus.GetChannelCount();
    if (direction == kDirection_Input)
    {
        pluginChannels = GetNumberOfInputChannels();
        available += mSideChainTargetBus.GetChannelCount();
    }
    channelmaps::CreateEmptyChannelMap(std::min(pluginChannels, available), true, MapOf(direction));
}

ChannelMap AudioFilter::BuildBestFitChannelMap(const std::vector<AudioFilterBusDescription>& buses,
                                               const ChannelLayout& target)
{
    ChannelMap map;
    if (buses.empty())
        return map;
    const ChannelLayout layout = buses.front().GetLayout();
    std::vector<bool> used(target.size(), false);
    bool matched = false;
    for (std::size_t i = 0; i < layout.size(); ++i)
    {
        for (std::size_t j = 0; j < target.size(); ++j)
        {
            if (used[j] || !(target[j] == layout[i]))
                continue;
            channelmaps::SetMapping(map, static_cast<int>(i), static_cast<int>(j));
            used[j] = matched = true;
            break;
        }
    }
    if (!matched) // No label agrees: by position, whatever the target's length
        channelmaps::CreateEmptyChannelMap(static_cast<int>(layout.size()), true, map);
    return map;
}

} // namespace zebaudiofilterhost
