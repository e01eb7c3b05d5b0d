#include "host/src/VST3/src/SpeakerArrangements.h"

#include <boost/bimap.hpp>

#include <algorithm>
#include <array>
#include <bit>
#include <string_view>

namespace zebaudiofilterhost::vst3
{

using Steinberg::Vst::Speaker;
using Steinberg::Vst::SpeakerArrangement;

namespace
{

struct NamedArrangement
{
    SpeakerArrangement mArrangement;
    std::u16string_view mName;
};

// Ours, so that saved bus names do not change with the version of the SDK.
constexpr std::array<NamedArrangement, 53> kArrangementNames = {{
    {0x80000, u"Mono"},
    {0x3, u"Stereo"},
    {0x30, u"Stereo (Ls Rs)"},
    {0xc0, u"Stereo (Lc Rc)"},
    {0x600, u"Stereo (Sl Sr)"},
    {0xc, u"Stereo (C LFE)"},
    {0x5000, u"Stereo (Tfl Tfr)"},
    {0x28000, u"Stereo (Trl Trr)"},
    {0x3000000, u"Stereo (Tsl Tsr)"},
    {0x50000000, u"Stereo (Bfl Bfr)"},
    {0x7, u"LRC"},
    {0x103, u"LRS"},
    {0xf, u"LRC+LFE"},
    {0x10b, u"LRS+LFE"},
    {0x107, u"LRCS"},
    {0x10f, u"LRCS+LFE"},
    {0x33, u"Quadro"},
    {0x3b, u"Quadro+LFE"},
    {0xf00000, u"BFormat"},
    {0x37, u"5.0"},
    {0x3f, u"5.1"},
    {0x137, u"6.0 Cine"},
    {0x13f, u"6.1 Cine"},
    {0x633, u"6.0 Music"},
    {0x63b, u"6.1 Music"},
    {0xf7, u"7.0 Cine (SDDS)"},
    {0xff, u"7.1 Cine (SDDS)"},
    {0x637, u"7.0 Music (Dolby)"},
    {0x63f, u"7.1 Music (Dolby)"},
    {0x93f, u"7.1 Cine Top Center"},
    {0x213f, u"7.1 Cine Center High"},
    {0x503f, u"7.1 Cine Front High"},
    {0x300003f, u"7.1 Cine Side High"},
    {0xc00003f, u"7.1 Cine Full Rear"},
    {0x18000003f, u"7.1 Proximity"},
    {0x1f7, u"8.0 Cine"},
    {0x1ff, u"8.1 Cine"},
    {0x737, u"8.0 Music"},
    {0x73f, u"8.1 Music"},
    {0x2000703b, u"8.1 MPEG"},
    {0x2d033, u"8.0 Cube"},
    {0x2d037, u"9.0 Auro-3D"},
    {0x2d03f, u"9.1 Auro-3D"},
    {0x300063f, u"9.1 Dolby Atmos"},
    {0x2d837, u"10.0 Auro-3D"},
    {0x2d83f, u"10.1 Auro-3D"},
    {0x6f03f, u"10.2 Experimental"},
    {0x2f837, u"11.0 Auro-3D"},
    {0x2f83f, u"11.1 Auro-3D"},
    {0x6f0ff, u"12.2"},
    {0x2fe37, u"13.0 Auro-3D"},
    {0x2fe3f, u"13.1 Auro-3D"},
    {0x7307ffff, u"22.2"},
}};

// The left side is ordered by speaker bit.
using SpeakerChannelLabelMap = boost::bimap<Speaker, AudioChannelLabel>;

SpeakerChannelLabelMap MakeSpeakerChannelLabelMap()
{
    using namespace zebmediatypes;
    constexpr std::array<AudioChannelLabel, 33> kLabelsByBit = {
        kAudioChannelLabel_Left,              // L
        kAudioChannelLabel_Right,             // R
        kAudioChannelLabel_Center,            // C
        kAudioChannelLabel_LFE,               // Lfe
        kAudioChannelLabel_LeftSurround,      // Ls
        kAudioChannelLabel_RightSurround,     // Rs
        kAudioChannelLabel_LeftCenter,        // Lc
        kAudioChannelLabel_RightCenter,       // Rc
        kAudioChannelLabel_CenterSurround,    // S
        kAudioChannelLabel_SideLeft,          // Sl
        kAudioChannelLabel_SideRight,         // Sr
        kAudioChannelLabel_TopCenter,         // Tc
        kAudioChannelLabel_TopFrontLeft,      // Tfl
        kAudioChannelLabel_TopFrontCenter,    // Tfc
        kAudioChannelLabel_TopFrontRight,     // Tfr
        kAudioChannelLabel_TopRearLeft,       // Trl
        kAudioChannelLabel_TopRearCenter,     // Trc
        kAudioChannelLabel_TopRearRight,      // Trr
        kAudioChannelLabel_LFE2,              // Lfe2
        kAudioChannelLabel_None,              // M
        kAudioChannelLabel_AmbisonicW,        // W
        kAudioChannelLabel_AmbisonicX,        // X
        kAudioChannelLabel_AmbisonicY,        // Y
        kAudioChannelLabel_AmbisonicZ,        // Z
        kAudioChannelLabel_TopSideLeft,       // Tsl
        kAudioChannelLabel_TopSideRight,      // Tsr
        kAudioChannelLabel_RearLeftSurround,  // Lcs
        kAudioChannelLabel_RearRightSurround, // Rcs
        kAudioChannelLabel_BottomFrontLeft,   // Bfl
        kAudioChannelLabel_BottomFrontCenter, // Bfc
        kAudioChannelLabel_BottomFrontRight,  // Bfr
        kAudioChannelLabel_ProximityLeft,     // Pl
        kAudioChannelLabel_ProximityRight,    // Pr
    };
    SpeakerChannelLabelMap map;
    for (std::size_t bit = 0; bit < kLabelsByBit.size(); ++bit)
        map.insert({Speaker(1) << bit, kLabelsByBit[bit]});
    return map;
}

const SpeakerChannelLabelMap& GetSpeakerChannelLabelMap()
{
    static const SpeakerChannelLabelMap kSpeakerChannelLabelMap = MakeSpeakerChannelLabelMap();
    return kSpeakerChannelLabelMap;
}

// 0 if a label has no speaker or is there twice.
SpeakerArrangement ArrangementByLabels(const ChannelLayout& layout)
{
    const auto& speakers = GetSpeakerChannelLabelMap().right;
    SpeakerArrangement arrangement = 0;
    for (const AudioChannelDescription& channel : layout)
    {
        const auto found = speakers.find(channel.GetLabel());
        if (found == speakers.end() || (arrangement & found->second) != 0)
            return 0;
        arrangement |= found->second;
    }
    return arrangement;
}

SpeakerArrangement ArrangementByCount(std::size_t channels)
{
    switch (channels)
    {
    case 1:
        return 0x80000; // mono
    case 2:
        return 0x3; // stereo
    case 4:
        return 0x33; // quadro
    case 6:
        return 0x3f; // 5.1
    case 8:
        return 0xff; // 7.1 with five front channels
    default:
        return 0;
    }
}

} // namespace

ChannelLayout LayoutOfArrangement(SpeakerArrangement arrangement)
{
    ChannelLayout layout;
    for (const auto& entry : GetSpeakerChannelLabelMap().left)
    {
        if ((arrangement & entry.first) != 0)
            layout.emplace_back(entry.second);
    }
    if (layout.empty())
        layout.resize(static_cast<std::size_t>(std::popcount(arrangement)));
    return layout;
}

SpeakerArrangement ArrangementOfLayout(const ChannelLayout& layout)
{
    const SpeakerArrangement byLabels = ArrangementByLabels(layout);
    return byLabels != 0 ? byLabels : ArrangementByCount(layout.size());
}

UTF16String ArrangementName(SpeakerArrangement arrangement)
{
    const auto* found =
        std::find_if(kArrangementNames.begin(), kArrangementNames.end(),
                     [arrangement](const NamedArrangement& entry) { return entry.mArrangement == arrangement; });
    return found == kArrangementNames.end() ? UTF16String() : UTF16String(found->mName);
}

} // namespace zebaudiofilterhost::vst3
