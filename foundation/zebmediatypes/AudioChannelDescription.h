#pragma once

#include "foundation/zebmediatypes/AudioChannelLabel.h"

namespace zebmediatypes
{

/// One channel: its label and nothing else.
class AudioChannelDescription
{
public:
    constexpr AudioChannelDescription() = default;
    /// Implicit, so that a layout can be written as a list of labels.
    constexpr AudioChannelDescription(AudioChannelLabel label) : mLabel(label) {}

    constexpr AudioChannelLabel GetLabel() const { return mLabel; }
    constexpr void SetLabel(AudioChannelLabel label) { mLabel = label; }

    constexpr bool operator==(const AudioChannelDescription&) const = default;

private:
    AudioChannelLabel mLabel = kAudioChannelLabel_None;
};

} // namespace zebmediatypes
