#include "foundation/zebmediatypes/ChannelLayout.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <set>
#include <vector>

using namespace zebmediatypes;

namespace
{

struct Case
{
    ChannelLayout (*mCreate)();
    zebcore::UTF16String mDescription;
};

const Case kCases[] = {
    {CreateMonoChannelLayout, u"Mono"},
    {CreateStereoChannelLayout, u"L R"},
    {CreateMatrixStereoChannelLayout, u"Lt Rt"},
    {CreateQuadraphonicChannelLayout, u"L R Ls Rs"},
    {CreatePentagonalChannelLayout, u"L R Ls Rs C"},
    {CreateHexagonalChannelLayout, u"L R Ls Rs C Cs"},
    {CreateOctagonalChannelLayout, u"L R Ls Rs C Cs Sl Sr"},
    {CreateCubeChannelLayout, u"L R Ls Rs Tfl Tfr Trl Trr"},
    {CreateAmbisonicsBFormatChannelLayout, u"W X Y Z"},
    {CreateSmpteDtvChannelLayout, u"L R C LFE Ls Rs Lt Rt"},
    {CreateBroadcast51ChannelLayout, u"L R C LFE Ls Rs"},
    {CreateLegacy51ChannelLayout, u"L R Ls Rs C LFE"},
    {Create7_1ChannelLayout, u"L R C LFE Ls Rs Lc Rc"},
    {Create7_1ItuChannelLayout, u"L R C LFE Ls Rs Rls Rrs"},
    {Create7_1MpegChannelLayout, u"C Lc Rc L R Ls Rs LFE"},
    {Create7_1EMagicChannelLayout, u"L R Ls Rs C LFE Lc Rc"},
    {Create_L_R_C_ChannelLayout, u"L R C"},
    {Create_C_L_R_ChannelLayout, u"C L R"},
    {Create_L_C_R_ChannelLayout, u"L C R"},
    {Create_L_R_Cs_ChannelLayout, u"L R Cs"},
    {Create_L_R_LFE_ChannelLayout, u"L R LFE"},
    {Create_L_R_C_Cs_ChannelLayout, u"L R C Cs"},
    {Create_C_L_R_Cs_ChannelLayout, u"C L R Cs"},
    {Create_L_C_R_Cs_ChannelLayout, u"L C R Cs"},
    {Create_L_R_C_LFE_ChannelLayout, u"L R C LFE"},
    {Create_L_C_R_LFE_ChannelLayout, u"L C R LFE"},
    {Create_L_R_Cs_LFE_ChannelLayout, u"L R Cs LFE"},
    {Create_L_R_LFE_Cs_ChannelLayout, u"L R LFE Cs"},
    {Create_L_R_C_Ls_Rs_ChannelLayout, u"L R C Ls Rs"},
    {Create_C_L_R_Ls_Rs_ChannelLayout, u"C L R Ls Rs"},
    {Create_L_C_R_Ls_Rs_ChannelLayout, u"L C R Ls Rs"},
    {Create_L_R_Ls_Rs_C_ChannelLayout, u"L R Ls Rs C"},
    {Create_L_C_R_Cs_LFE_ChannelLayout, u"L C R Cs LFE"},
    {Create_L_R_C_LFE_Cs_ChannelLayout, u"L R C LFE Cs"},
    {Create_L_R_LFE_Ls_Rs_ChannelLayout, u"L R LFE Ls Rs"},
    {Create_L_R_Ls_Rs_LFE_ChannelLayout, u"L R Ls Rs LFE"},
    {Create_C_L_R_Ls_Rs_Cs_ChannelLayout, u"C L R Ls Rs Cs"},
    {Create_C_L_R_Ls_Rs_LFE_ChannelLayout, u"C L R Ls Rs LFE"},
    {Create_L_C_R_Ls_Rs_LFE_ChannelLayout, u"L C R Ls Rs LFE"},
    {Create_L_R_Ls_Rs_C_Lc_Rc_ChannelLayout, u"L R Ls Rs C Lc Rc"},
    {Create_C_L_R_Ls_Rs_Cs_LFE_ChannelLayout, u"C L R Ls Rs Cs LFE"},
    {Create_L_R_C_LFE_Ls_Rs_Cs_ChannelLayout, u"L R C LFE Ls Rs Cs"},
    {Create_C_L_R_Ls_Rs_Rls_Rrs_ChannelLayout, u"C L R Ls Rs Rls Rrs"},
    {Create_L_R_Ls_Rs_C_Rls_Rrs_ChannelLayout, u"L R Ls Rs C Rls Rrs"},
    {Create_C_L_R_Ls_Rs_Rls_Rrs_Cs_ChannelLayout, u"C L R Ls Rs Rls Rrs Cs"},
};

std::vector<std::uint32_t> Numbers(const ChannelLayout& layout)
{
    std::vector<std::uint32_t> numbers;
    for (const AudioChannelDescription& channel : layout)
        numbers.push_back(channel.GetLabel());
    return numbers;
}

TEST(ChannelLayout, EachFunctionListsItsChannelsInOrder)
{
    for (const Case& layout : kCases)
        EXPECT_TRUE(AudioChannelLayoutDescription(layout.mCreate()) == layout.mDescription) << &layout - kCases;
}

TEST(ChannelLayout, NumbersAreThoseThatSettingsHold)
{
    using List = std::vector<std::uint32_t>;
    EXPECT_EQ((List{0}), Numbers(CreateMonoChannelLayout()));
    EXPECT_EQ((List{100, 101}), Numbers(CreateStereoChannelLayout()));
    EXPECT_EQ((List{132, 133}), Numbers(CreateMatrixStereoChannelLayout()));
    EXPECT_EQ((List{100, 101, 102, 103, 104, 105}), Numbers(CreateBroadcast51ChannelLayout()));
    EXPECT_EQ((List{100, 101, 102, 103, 104, 105, 107, 108}), Numbers(Create7_1ChannelLayout()));
    EXPECT_EQ((List{102, 100, 101, 104, 105, 129, 130, 106}), Numbers(Create_C_L_R_Ls_Rs_Rls_Rrs_Cs_ChannelLayout()));
    EXPECT_EQ((List{100, 101, 104, 105, 112, 113, 115, 116}), Numbers(CreateCubeChannelLayout()));
    EXPECT_EQ((List{100, 101, 104, 105, 102, 106, 109, 110}), Numbers(CreateOctagonalChannelLayout()));
    EXPECT_EQ((List{134, 135, 136, 137}), Numbers(CreateAmbisonicsBFormatChannelLayout()));
}

TEST(ChannelLayout, HasEachLabelOnce)
{
    for (const Case& layout : kCases)
    {
        const auto numbers = Numbers(layout.mCreate());
        EXPECT_EQ(numbers.size(), std::set(numbers.begin(), numbers.end()).size()) << &layout - kCases;
    }
}

TEST(ChannelLayout, DescriptionNamesWhatHasNoLabel)
{
    EXPECT_TRUE(AudioChannelLayoutDescription({}).empty());
    EXPECT_TRUE(AudioChannelLayoutDescription(ChannelLayout(24)) == u"24 channels");
    EXPECT_TRUE(AudioChannelLayoutDescription({kAudioChannelLabel_Left, kAudioChannelLabel_None}) == u"L -");
    EXPECT_TRUE(AudioChannelLayoutDescription({static_cast<AudioChannelLabel>(7)}) == u"7");
}

} // namespace
