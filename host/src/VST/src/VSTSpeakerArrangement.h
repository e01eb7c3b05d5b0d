#pragma once

#include "host/src/VST/interface/VST2Interface.h"
#include "utility/CommonTypes.h"

#include <cstddef>
#include <memory>

namespace zebaudiofilterhost::vst
{

struct FreeSpeakerArrangement
{
    void operator()(VstSpeakerArrangement* arrangement) const noexcept;
};

/// An arrangement in memory of the host's, with as many speaker records as it has channels, and never fewer than the
/// eight that are declared.
using SpeakerArrangementPtr = std::unique_ptr<VstSpeakerArrangement, FreeSpeakerArrangement>;

/// More channels than this are not believed of an arrangement that a plug-in gives.
inline constexpr int kMaxArrangedChannels = 64;

/// Bytes of the host's memory for an arrangement of so many channels. [any]
constexpr std::size_t SpeakerArrangementSize(std::size_t channelCount)
{
    constexpr std::size_t kDeclared = 8;
    // Records start behind eight bytes; the product is a multiple of 16, so that "or" adds them.
    return channelCount <= kDeclared ? sizeof(VstSpeakerArrangement)
                                     : (channelCount * sizeof(VstSpeakerProperties)) | kDeclared;
}

/// What the host asks a plug-in for. Only the number of channels counts, not their roles. [main]
SpeakerArrangementPtr BuildSpeakerArrangement(const ChannelLayout& layout);

/// A copy of what a plug-in gave, which must have 1 to kMaxArrangedChannels channels. Of its speaker records not more
/// than `readable` are read: what stands behind them may not be the plug-in's. [main]
SpeakerArrangementPtr CopySpeakerArrangement(const VstSpeakerArrangement& source, int readable);

} // namespace zebaudiofilterhost::vst
