#include "foundation/zebmediatypes/ChannelMap.h"

#include <algorithm>

namespace zebmediatypes
{

ChannelMap::ChannelMap() = default;
ChannelMap::ChannelMap(const ChannelMap& other) = default;
ChannelMap& ChannelMap::operator=(const ChannelMap& other) = default;
ChannelMap::~ChannelMap() = default;

ChannelMap::ChannelMap(int slotCount)
{
    for (int i = 0; i < slotCount; ++i)
        AddChannel({static_cast<AudioChannelLabel>(i)}, i);
}

int ChannelMap::GetNumberOfChannels() const
{
    return static_cast<int>(mSlots.size());
}

const ChannelLayout& ChannelMap::GetChannelLayout(int slot) const
{
    static const ChannelLayout& sNoLayout = *new ChannelLayout;
    return HasSlot(slot) ? mSlots[static_cast<std::size_t>(slot)].mLayout : sNoLayout;
}

void ChannelMap::SetChannelLayout(int slot, const ChannelLayout& layout)
{
    if (HasSlot(slot))
        mSlots[static_cast<std::size_t>(slot)].mLayout = layout;
}

void ChannelMap::SetChannel(int slot, int sourceChannel)
{
    if (HasSlot(slot))
        mSlots[static_cast<std::size_t>(slot)].mSourceChannel = sourceChannel;
}

void ChannelMap::AddChannel(const ChannelLayout& layout, int sourceChannel)
{
    mSlots.push_back({layout, sourceChannel});
}

int ChannelMap::Find(int sourceChannel) const
{
    const auto slot = std::find_if(mSlots.begin(), mSlots.end(),
                                   [&](const Slot& candidate) { return candidate.mSourceChannel == sourceChannel; });
    const bool found = sourceChannel >= 0 && slot != mSlots.end();
    return found ? static_cast<int>(slot - mSlots.begin()) : -1;
}

int ChannelMap::GetSourceChannelIndexForChannelLabel(AudioChannelLabel label) const
{
    const auto slot = std::find_if(mSlots.begin(), mSlots.end(),
                                   [&](const Slot& candidate)
                                   {
                                       return std::find(candidate.mLayout.begin(), candidate.mLayout.end(),
                                                        AudioChannelDescription(label)) != candidate.mLayout.end();
                                   });
    return slot != mSlots.end() ? slot->mSourceChannel : -1;
}

bool ChannelMap::operator==(const ChannelMap& other) const
{
    return mSlots == other.mSlots;
}

bool ChannelMap::HasSlot(int slot) const
{
    return slot >= 0 && slot < GetNumberOfChannels();
}

} // namespace zebmediatypes
