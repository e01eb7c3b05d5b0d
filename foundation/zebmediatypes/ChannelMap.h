#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebmediatypes/AudioChannelLabel.h"
#include "foundation/zebmediatypes/ChannelLayout.h"

#include <vector>

namespace zebmediatypes
{

/// Ordered list of slots, each with a channel layout and the index of a source channel, -1 for none. Slot indices
/// outside the map are ignored by the setters and read as an empty layout. [one thread at a time]
class ZEB_EXPORT ChannelMap
{
public:
    ChannelMap();
    /// The identity arrangement: slot i has the layout [i] and the source channel i. A negative count gives an empty
    /// map.
    explicit ChannelMap(int slotCount);
    ChannelMap(const ChannelMap& other);
    ChannelMap& operator=(const ChannelMap& other);
    ~ChannelMap();

    int GetNumberOfChannels() const;
    const ChannelLayout& GetChannelLayout(int slot) const;

    /// Replaces the layout of a slot.
    void SetChannelLayout(int slot, const ChannelLayout& layout);
    /// Connects a slot to a source channel, or disconnects it with -1.
    void SetChannel(int slot, int sourceChannel);
    /// Appends a slot.
    void AddChannel(const ChannelLayout& layout, int sourceChannel);

    /// The first slot that is connected to this source channel, or -1.
    int Find(int sourceChannel) const;
    /// The source channel of the first slot whose layout has this label, or -1. Note that Find speaks of sources and
    /// this operation of what the layouts hold: two number spaces.
    int GetSourceChannelIndexForChannelLabel(AudioChannelLabel label) const;

    bool operator==(const ChannelMap& other) const;

private:
    struct Slot
    {
        ChannelLayout mLayout;
        int mSourceChannel = -1;

        bool operator==(const Slot&) const = default;
    };

    bool HasSlot(int slot) const;

    std::vector<Slot> mSlots;
};

} // namespace zebmediatypes
