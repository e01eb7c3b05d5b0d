// Channel maps in settings.
#include "audiofilter/AudioFilter.h"
#include "audiofilter/src/ChannelMapEditing.h"
#include "foundation/zebcore/StringConversion.h"

#include <boost/thread/locks.hpp>

#include <algorithm>
#include <string>
#include <string_view>

namespace zebaudiofilterhost
{

using MapLock = boost::unique_lock<boost::recursive_mutex>;

namespace
{

constexpr char8_t kInputMappingKey[] = u8"InputMapping";
constexpr char8_t kOutputMappingKey[] = u8"OutputMapping";
constexpr char8_t kCountKey[] = u8"C";
constexpr std::u8string_view kSlotKey = u8"S_";
constexpr std::u8string_view kPlugChannelKey = u8"D_";

UTF8String IndexedKey(std::u8string_view base, unsigned int n)
{
    return UTF8String(base) + zebcore::utility::UTF8FromNarrow(std::to_string(n));
}

// Each bus is tested by itself, without the offset of its channels in the plug-in's row.
bool IsValidPlugChannel(int plugChannel, const std::vector<AudioFilterBusDescription>& buses)
{
    return std::any_of(buses.begin(), buses.end(),
                       [plugChannel](const AudioFilterBusDescription& bus)
                       { return bus.GetChannelCount() > plugChannel; });
}

bool LoadRecords(const PropList& section, unsigned int count, const std::vector<AudioFilterBusDescription>& buses,
                 std::vector<bool>& seen, ChannelMap& map)
{
    // Ends at the first record that is missing, however many the count claims.
    for (unsigned int read = 0; read < count; ++read)
    {
        int slot = 0;
        int plugChannel = 0;
        if (!section.GetValue(IndexedKey(kSlotKey, read + 1), slot) ||
            !section.GetValue(IndexedKey(kPlugChannelKey, read + 1), plugChannel))
            return false;
        if (slot < 0 || static_cast<std::size_t>(slot) >= seen.size())
            continue;
        seen[static_cast<std::size_t>(slot)] = true;
        if (plugChannel >= 0 && IsValidPlugChannel(plugChannel, buses))
            channelmaps::SetMapping(map, plugChannel, slot);
    }
    return true;
}

bool LoadChannelMap(const PropList& section, const ChannelLayout& target,
                    const std::vector<AudioFilterBusDescription>& buses, ChannelMap& map)
{
    ChannelMap loaded;
    channelmaps::CreateEmptyChannelMap(static_cast<int>(target.size()), false, loaded);
    unsigned int count = 0;
    std::vector<bool> seen(target.size(), false);
    if (!section.GetValue(kCountKey, count) || !LoadRecords(section, count, buses, seen, loaded))
        return false;
    for (std::size_t channel = 0; channel < seen.size(); ++channel)
    {
        if (!seen[channel]) // Straight through, while a recorded -1 leaves its channel unconnected
            channelmaps::SetMapping(loaded, static_cast<int>(channel), static_cast<int>(channel));
    }
    map = loaded;
    return true;
}

void SaveChannelMap(const ChannelMap& map, PropList& section)
{
    unsigned int count = 0;
    const auto addRecord = [&](int slot, int plugChannel)
    {
        ++count;
        section.SetValue(IndexedKey(kSlotKey, count), slot);
        section.SetValue(IndexedKey(kPlugChannelKey, count), plugChannel);
    };
    for (int slot = 0; slot < map.GetNumberOfChannels(); ++slot)
    {
        const ChannelLayout& layout = map.GetChannelLayout(slot);
        if (map.Find(slot) >= 0 && !layout.empty())
        {
            for (const AudioChannelDescription& plugChannel : layout)
                addRecord(slot, static_cast<int>(plugChannel.GetLabel()));
        }
        else
            addRecord(slot, -1);
    }
    section.SetValue(kCountKey, count);
}

} // namespace

bool AudioFilter::LoadChannelMapSettings(const PropList* settings)
{
    const MapLock lock(mChannelMapMutex);
    if (!GetUseChannelMap() || settings == nullptr)
        return false;
    const ChannelLayout target = mMainTargetBus.GetLayout();
    const PropList* inputs = settings->GetSubList(kInputMappingKey);
    if (inputs == nullptr || !LoadChannelMap(*inputs, target, mInputBuses, mInputChannelMap))
        return false;
    const PropList* outputs = settings->GetSubList(kOutputMappingKey);
    return outputs != nullptr && LoadChannelMap(*outputs, target, mOutputBuses, mOutputChannelMap);
}

bool AudioFilter::SaveChannelMapSettings(PropList* settings) const
{
    const MapLock lock(mChannelMapMutex);
    if (!GetUseChannelMap() || settings == nullptr)
        return false;
    SaveChannelMap(mInputChannelMap, settings->GetOrCreateSubList(kInputMappingKey));
    SaveChannelMap(mOutputChannelMap, settings->GetOrCreateSubList(kOutputMappingKey));
    return true;
}

} // namespace zebaudiofilterhost
