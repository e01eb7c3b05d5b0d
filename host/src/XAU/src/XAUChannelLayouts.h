#pragma once

#include "utility/CommonTypes.h"

#include <AudioToolbox/AudioToolbox.h>

namespace zebaudiofilterhost::xau
{

/// Of a unit's channel label; 0 for one without a counterpart. [any]
zebmediatypes::AudioChannelLabel TranslateLabel(UInt32 label);

/// In the order of the bits. Bits without a counterpart are left out. [any]
ChannelLayout TranslateBitmap(UInt32 bitmap);

/// Of a tag that names a whole layout; empty for one that is not known. [any]
ChannelLayout TranslateTag(UInt32 tag);

} // namespace zebaudiofilterhost::xau
