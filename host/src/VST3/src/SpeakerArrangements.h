#pragma once

#include "utility/CommonTypes.h"

#include <pluginterfaces/vst/vsttypes.h>

namespace zebaudiofilterhost::vst3
{

/// The channels of an arrangement, in the order of its speaker bits. Speakers without a label give no channel, unless
/// none has one: then there is one channel without a label for each bit. [any]
ChannelLayout LayoutOfArrangement(Steinberg::Vst::SpeakerArrangement arrangement);

/// The arrangement of a layout, whatever the order of its channels: by their labels or, where one has no speaker or
/// two have the same, by their number. 0 where that gives none either. [any]
Steinberg::Vst::SpeakerArrangement ArrangementOfLayout(const ChannelLayout& layout);

/// Such as "5.1"; empty for an arrangement without a name. [any]
UTF16String ArrangementName(Steinberg::Vst::SpeakerArrangement arrangement);

} // namespace zebaudiofilterhost::vst3
