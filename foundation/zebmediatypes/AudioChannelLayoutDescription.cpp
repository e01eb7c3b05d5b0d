#include "foundation/zebcore/StringStreams.h"
#include "foundation/zebmediatypes/ChannelLayout.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace zebmediatypes
{

namespace
{

struct LabelName
{
    AudioChannelLabel mLabel;
    std::u16string_view mName;
};

constexpr std::array kLabelNames{
    LabelName{kAudioChannelLabel_None, u"-"},
    LabelName{kAudioChannelLabel_Left, u"L"},
    LabelName{kAudioChannelLabel_Right, u"R"},
    LabelName{kAudioChannelLabel_Center, u"C"},
    LabelName{kAudioChannelLabel_LFE, u"LFE"},
    LabelName{kAudioChannelLabel_LeftSurround, u"Ls"},
    LabelName{kAudioChannelLabel_RightSurround, u"Rs"},
    LabelName{kAudioChannelLabel_CenterSurround, u"Cs"},
    LabelName{kAudioChannelLabel_LeftCenter, u"Lc"},
    LabelName{kAudioChannelLabel_RightCenter, u"Rc"},
    LabelName{kAudioChannelLabel_SideLeft, u"Sl"},
    LabelName{kAudioChannelLabel_SideRight, u"Sr"},
    LabelName{kAudioChannelLabel_TopCenter, u"Tc"},
    LabelName{kAudioChannelLabel_TopFrontLeft, u"Tfl"},
    LabelName{kAudioChannelLabel_TopFrontRight, u"Tfr"},
    LabelName{kAudioChannelLabel_TopFrontCenter, u"Tfc"},
    LabelName{kAudioChannelLabel_TopRearLeft, u"Trl"},
    LabelName{kAudioChannelLabel_TopRearRight, u"Trr"},
    LabelName{kAudioChannelLabel_TopRearCenter, u"Trc"},
    LabelName{kAudioChannelLabel_LeftWide, u"Lw"},
    LabelName{kAudioChannelLabel_RightWide, u"Rw"},
    LabelName{kAudioChannelLabel_TopSideLeft, u"Tsl"},
    LabelName{kAudioChannelLabel_TopSideRight, u"Tsr"},
    LabelName{kAudioChannelLabel_RearLeftSurround, u"Rls"},
    LabelName{kAudioChannelLabel_RearRightSurround, u"Rrs"},
    LabelName{kAudioChannelLabel_LFE2, u"LFE2"},
    LabelName{kAudioChannelLabel_LeftTotal, u"Lt"},
    LabelName{kAudioChannelLabel_RightTotal, u"Rt"},
    LabelName{kAudioChannelLabel_AmbisonicW, u"W"},
    LabelName{kAudioChannelLabel_AmbisonicX, u"X"},
    LabelName{kAudioChannelLabel_AmbisonicY, u"Y"},
    LabelName{kAudioChannelLabel_AmbisonicZ, u"Z"},
    LabelName{kAudioChannelLabel_BottomFrontLeft, u"Bfl"},
    LabelName{kAudioChannelLabel_BottomFrontCenter, u"Bfc"},
    LabelName{kAudioChannelLabel_BottomFrontRight, u"Bfr"},
    LabelName{kAudioChannelLabel_ProximityLeft, u"Pl"},
    LabelName{kAudioChannelLabel_ProximityRight, u"Pr"},
};

void WriteLabel(zebcore::utility::oUTF16StringStream& text, AudioChannelLabel label)
{
    const auto* known = std::find_if(kLabelNames.begin(), kLabelNames.end(),
                                     [&](const LabelName& name) { return name.mLabel == label; });
    if (known != kLabelNames.end())
        text << known->mName;
    else
        text << static_cast<std::uint32_t>(label);
}

bool HasNoLabel(const AudioChannelDescription& channel)
{
    return channel.GetLabel() == kAudioChannelLabel_None;
}

} // namespace

zebcore::UTF16String AudioChannelLayoutDescription(const ChannelLayout& layout)
{
    zebcore::utility::oUTF16StringStream text;
    if (layout.size() == 1 && HasNoLabel(layout[0]))
        return u"Mono";
    if (layout.size() > 1 && std::all_of(layout.begin(), layout.end(), HasNoLabel))
    {
        text << layout.size() << " channels";
        return text.str();
    }
    for (std::size_t i = 0; i < layout.size(); ++i)
    {
        text << (i == 0 ? "" : " ");
        WriteLabel(text, layout[i].GetLabel());
    }
    return text.str();
}

} // namespace zebmediatypes
