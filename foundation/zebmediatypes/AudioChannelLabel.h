#pragma once

#include <cstdint>

namespace zebmediatypes
{

/// Role of a channel. The numbers stand in saved settings. Any other 32-bit value is legal: channel maps put channel
/// numbers here.
enum AudioChannelLabel : std::uint32_t
{
    kAudioChannelLabel_None = 0, ///< No role of its own: mono, or one of many alike.

    kAudioChannelLabel_Left = 100,
    kAudioChannelLabel_Right = 101,
    kAudioChannelLabel_Center = 102,
    kAudioChannelLabel_LFE = 103,
    kAudioChannelLabel_LeftSurround = 104,
    kAudioChannelLabel_RightSurround = 105,
    kAudioChannelLabel_CenterSurround = 106,
    kAudioChannelLabel_LeftCenter = 107,
    kAudioChannelLabel_RightCenter = 108,
    kAudioChannelLabel_SideLeft = 109,
    kAudioChannelLabel_SideRight = 110,
    kAudioChannelLabel_TopCenter = 111,
    kAudioChannelLabel_TopFrontLeft = 112,
    kAudioChannelLabel_TopFrontRight = 113,
    kAudioChannelLabel_TopFrontCenter = 114,
    kAudioChannelLabel_TopRearLeft = 115,
    kAudioChannelLabel_TopRearRight = 116,
    kAudioChannelLabel_TopRearCenter = 117,
    kAudioChannelLabel_LeftWide = 118,
    kAudioChannelLabel_RightWide = 119,
    kAudioChannelLabel_TopSideLeft = 127,
    kAudioChannelLabel_TopSideRight = 128,
    kAudioChannelLabel_RearLeftSurround = 129,
    kAudioChannelLabel_RearRightSurround = 130,
    kAudioChannelLabel_LFE2 = 131,
    kAudioChannelLabel_LeftTotal = 132,
    kAudioChannelLabel_RightTotal = 133,
    kAudioChannelLabel_AmbisonicW = 134,
    kAudioChannelLabel_AmbisonicX = 135,
    kAudioChannelLabel_AmbisonicY = 136,
    kAudioChannelLabel_AmbisonicZ = 137,
    kAudioChannelLabel_BottomFrontLeft = 138,
    kAudioChannelLabel_BottomFrontCenter = 139,
    kAudioChannelLabel_BottomFrontRight = 140,
    kAudioChannelLabel_ProximityLeft = 141,
    kAudioChannelLabel_ProximityRight = 142,
};

} // namespace zebmediatypes
