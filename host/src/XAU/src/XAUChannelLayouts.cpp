#include "host/src/XAU/src/XAUChannelLayouts.h"

#include "foundation/zebmediatypes/ChannelLayout.h"

#include <algorithm>
#include <array>
#include <utility>

namespace zebaudiofilterhost::xau
{

namespace
{

using zebmediatypes::AudioChannelLabel;

struct LabelPair
{
    UInt32 mUnits;
    AudioChannelLabel mOurs;
};

// Sorted by the unit's label. The bits of a bitmap are the labels from 1 on.
constexpr std::array kLabels{
    LabelPair{1, zebmediatypes::kAudioChannelLabel_Left},
    LabelPair{2, zebmediatypes::kAudioChannelLabel_Right},
    LabelPair{3, zebmediatypes::kAudioChannelLabel_Center},
    LabelPair{4, zebmediatypes::kAudioChannelLabel_LFE},
    LabelPair{5, zebmediatypes::kAudioChannelLabel_LeftSurround},
    LabelPair{6, zebmediatypes::kAudioChannelLabel_RightSurround},
    LabelPair{7, zebmediatypes::kAudioChannelLabel_LeftCenter},
    LabelPair{8, zebmediatypes::kAudioChannelLabel_RightCenter},
    LabelPair{9, zebmediatypes::kAudioChannelLabel_CenterSurround},
    LabelPair{10, zebmediatypes::kAudioChannelLabel_SideLeft},
    LabelPair{11, zebmediatypes::kAudioChannelLabel_SideRight},
    LabelPair{12, zebmediatypes::kAudioChannelLabel_TopCenter},
    LabelPair{13, zebmediatypes::kAudioChannelLabel_TopFrontLeft},
    LabelPair{14, zebmediatypes::kAudioChannelLabel_TopFrontCenter},
    LabelPair{15, zebmediatypes::kAudioChannelLabel_TopFrontRight},
    LabelPair{16, zebmediatypes::kAudioChannelLabel_TopRearLeft},
    LabelPair{17, zebmediatypes::kAudioChannelLabel_TopRearCenter},
    LabelPair{18, zebmediatypes::kAudioChannelLabel_TopRearRight},
    LabelPair{33, zebmediatypes::kAudioChannelLabel_RearLeftSurround},
    LabelPair{34, zebmediatypes::kAudioChannelLabel_RearRightSurround},
    LabelPair{35, zebmediatypes::kAudioChannelLabel_LeftWide},
    LabelPair{36, zebmediatypes::kAudioChannelLabel_RightWide},
    LabelPair{37, zebmediatypes::kAudioChannelLabel_LFE2},
    LabelPair{38, zebmediatypes::kAudioChannelLabel_LeftTotal},
    LabelPair{39, zebmediatypes::kAudioChannelLabel_RightTotal},
    LabelPair{200, zebmediatypes::kAudioChannelLabel_AmbisonicW},
    LabelPair{201, zebmediatypes::kAudioChannelLabel_AmbisonicX},
    LabelPair{202, zebmediatypes::kAudioChannelLabel_AmbisonicY},
    LabelPair{203, zebmediatypes::kAudioChannelLabel_AmbisonicZ},
    LabelPair{301, zebmediatypes::kAudioChannelLabel_Left},
    LabelPair{302, zebmediatypes::kAudioChannelLabel_Right},
};

constexpr unsigned int kBitCount = 18;

struct TagPair
{
    UInt32 mTag;
    ChannelLayout (*mCreate)();
};

ChannelLayout CreateTmh102StandardLayout()
{
    return {zebmediatypes::kAudioChannelLabel_Left,         zebmediatypes::kAudioChannelLabel_Right,
            zebmediatypes::kAudioChannelLabel_Center,       zebmediatypes::kAudioChannelLabel_TopFrontCenter,
            zebmediatypes::kAudioChannelLabel_SideLeft,     zebmediatypes::kAudioChannelLabel_SideRight,
            zebmediatypes::kAudioChannelLabel_LeftSurround, zebmediatypes::kAudioChannelLabel_RightSurround,
            zebmediatypes::kAudioChannelLabel_TopFrontLeft, zebmediatypes::kAudioChannelLabel_TopFrontRight,
            zebmediatypes::kAudioChannelLabel_LeftWide,     zebmediatypes::kAudioChannelLabel_RightWide,
            zebmediatypes::kAudioChannelLabel_None,         zebmediatypes::kAudioChannelLabel_CenterSurround,
            zebmediatypes::kAudioChannelLabel_LFE,          zebmediatypes::kAudioChannelLabel_LFE2};
}

// The same with more, of which the last three have no counterpart.
ChannelLayout CreateTmh102FullLayout()
{
    ChannelLayout layout = CreateTmh102StandardLayout();
    layout.insert(layout.end(),
                  {zebmediatypes::kAudioChannelLabel_LeftCenter, zebmediatypes::kAudioChannelLabel_RightCenter,
                   zebmediatypes::kAudioChannelLabel_None, zebmediatypes::kAudioChannelLabel_None,
                   zebmediatypes::kAudioChannelLabel_None});
    return layout;
}

// Sorted by tag.
constexpr std::array kTags{
    TagPair{0x640001, zebmediatypes::CreateMonoChannelLayout},
    TagPair{0x650002, zebmediatypes::CreateStereoChannelLayout},
    TagPair{0x670002, zebmediatypes::CreateMatrixStereoChannelLayout},
    TagPair{0x6b0004, zebmediatypes::CreateAmbisonicsBFormatChannelLayout},
    TagPair{0x6c0004, zebmediatypes::CreateQuadraphonicChannelLayout},
    TagPair{0x6d0005, zebmediatypes::CreatePentagonalChannelLayout},
    TagPair{0x6e0006, zebmediatypes::CreateHexagonalChannelLayout},
    TagPair{0x6f0008, zebmediatypes::CreateOctagonalChannelLayout},
    TagPair{0x700008, zebmediatypes::CreateCubeChannelLayout},
    TagPair{0x710003, zebmediatypes::Create_L_R_C_ChannelLayout},
    TagPair{0x720003, zebmediatypes::Create_C_L_R_ChannelLayout},
    TagPair{0x730004, zebmediatypes::Create_L_R_C_Cs_ChannelLayout},
    TagPair{0x740004, zebmediatypes::Create_C_L_R_Cs_ChannelLayout},
    TagPair{0x750005, zebmediatypes::Create_L_R_C_Ls_Rs_ChannelLayout},
    TagPair{0x760005, zebmediatypes::Create_L_R_Ls_Rs_C_ChannelLayout},
    TagPair{0x770005, zebmediatypes::Create_L_C_R_Ls_Rs_ChannelLayout},
    TagPair{0x780005, zebmediatypes::Create_C_L_R_Ls_Rs_ChannelLayout},
    TagPair{0x790006, zebmediatypes::CreateBroadcast51ChannelLayout},
    TagPair{0x7a0006, zebmediatypes::CreateLegacy51ChannelLayout},
    TagPair{0x7b0006, zebmediatypes::Create_L_C_R_Ls_Rs_LFE_ChannelLayout},
    TagPair{0x7c0006, zebmediatypes::Create_C_L_R_Ls_Rs_LFE_ChannelLayout},
    TagPair{0x7d0007, zebmediatypes::Create_L_R_C_LFE_Ls_Rs_Cs_ChannelLayout},
    TagPair{0x7e0008, zebmediatypes::Create7_1ChannelLayout},
    TagPair{0x7f0008, zebmediatypes::Create7_1MpegChannelLayout},
    TagPair{0x800008, zebmediatypes::Create7_1ItuChannelLayout},
    TagPair{0x810008, zebmediatypes::Create7_1EMagicChannelLayout},
    TagPair{0x820008, zebmediatypes::CreateSmpteDtvChannelLayout},
    TagPair{0x830003, zebmediatypes::Create_L_R_Cs_ChannelLayout},
    TagPair{0x850003, zebmediatypes::Create_L_R_LFE_ChannelLayout},
    TagPair{0x860004, zebmediatypes::Create_L_R_LFE_Cs_ChannelLayout},
    TagPair{0x870005, zebmediatypes::Create_L_R_LFE_Ls_Rs_ChannelLayout},
    TagPair{0x880004, zebmediatypes::Create_L_R_C_LFE_ChannelLayout},
    TagPair{0x890005, zebmediatypes::Create_L_R_C_LFE_Cs_ChannelLayout},
    TagPair{0x8a0005, zebmediatypes::Create_L_R_Ls_Rs_LFE_ChannelLayout},
    TagPair{0x8c0007, zebmediatypes::Create_L_R_Ls_Rs_C_Rls_Rrs_ChannelLayout},
    TagPair{0x8d0006, zebmediatypes::Create_C_L_R_Ls_Rs_Cs_ChannelLayout},
    TagPair{0x8e0007, zebmediatypes::Create_C_L_R_Ls_Rs_Cs_LFE_ChannelLayout},
    TagPair{0x8f0007, zebmediatypes::Create_C_L_R_Ls_Rs_Rls_Rrs_ChannelLayout},
    TagPair{0x900008, zebmediatypes::Create_C_L_R_Ls_Rs_Rls_Rrs_Cs_ChannelLayout},
    TagPair{0x910010, CreateTmh102StandardLayout},
    TagPair{0x920015, CreateTmh102FullLayout},
    TagPair{0x940007, zebmediatypes::Create_L_R_Ls_Rs_C_Lc_Rc_ChannelLayout},
    TagPair{0x960003, zebmediatypes::Create_L_C_R_ChannelLayout},
    TagPair{0x970004, zebmediatypes::Create_L_C_R_Cs_ChannelLayout},
    TagPair{0x980004, zebmediatypes::Create_L_C_R_LFE_ChannelLayout},
    TagPair{0x990004, zebmediatypes::Create_L_R_Cs_LFE_ChannelLayout},
    TagPair{0x9a0005, zebmediatypes::Create_L_C_R_Cs_LFE_ChannelLayout},
};

} // namespace

AudioChannelLabel TranslateLabel(UInt32 label)
{
    const auto found = std::lower_bound(kLabels.begin(), kLabels.end(), label,
                                        [](const LabelPair& pair, UInt32 wanted) { return pair.mUnits < wanted; });
    return found != kLabels.end() && found->mUnits == label ? found->mOurs : zebmediatypes::kAudioChannelLabel_None;
}

ChannelLayout TranslateBitmap(UInt32 bitmap)
{
    ChannelLayout layout;
    for (unsigned int bit = 0; bit < kBitCount; ++bit)
    {
        if ((bitmap >> bit & 1U) != 0)
            layout.emplace_back(TranslateLabel(bit + 1));
    }
    return layout;
}

ChannelLayout TranslateTag(UInt32 tag)
{
    const auto found = std::lower_bound(kTags.begin(), kTags.end(), tag,
                                        [](const TagPair& pair, UInt32 wanted) { return pair.mTag < wanted; });
    return found != kTags.end() && found->mTag == tag ? found->mCreate() : ChannelLayout();
}

} // namespace zebaudiofilterhost::xau
