#include "host/src/VST3/src/SpeakerArrangements.h"

#include <pluginterfaces/vst/vstspeaker.h>

#include <gtest/gtest.h>

using namespace Steinberg::Vst;
using namespace zebaudiofilterhost::vst3;
using zebaudiofilterhost::AudioChannelLabel;
using zebaudiofilterhost::ChannelLayout;

namespace
{

std::vector<int> Labels(SpeakerArrangement arrangement)
{
    std::vector<int> labels;
    for (const auto& channel : LayoutOfArrangement(arrangement))
        labels.push_back(static_cast<int>(channel.GetLabel()));
    return labels;
}

ChannelLayout Layout(const std::vector<int>& labels)
{
    ChannelLayout layout;
    for (const int label : labels)
        layout.emplace_back(static_cast<AudioChannelLabel>(label));
    return layout;
}

} // namespace

TEST(SpeakerArrangements, LabelsComeInTheOrderOfTheBits)
{
    using List = std::vector<int>;
    EXPECT_EQ(Labels(SpeakerArr::kStereo), (List{100, 101}));
    EXPECT_EQ(Labels(SpeakerArr::k51), (List{100, 101, 102, 103, 104, 105}));
    EXPECT_EQ(Labels(SpeakerArr::kMono), (List{0}));
    EXPECT_EQ(Labels(SpeakerArr::kEmpty), (List{}));
    // All bits that have a label: top front and top rear are crossed against their bits.
    EXPECT_EQ(Labels(0x1ffffffff),
              (List{100, 101, 102, 103, 104, 105, 107, 108, 106, 109, 110, 111, 112, 114, 113, 115, 117,
                    116, 131, 0,   134, 135, 136, 137, 127, 128, 129, 130, 138, 139, 140, 141, 142}));
}

TEST(SpeakerArrangements, SpeakersWithoutLabelCountOnlyAmongThemselves)
{
    EXPECT_EQ(Labels(SpeakerArrangement(7) << 40), (std::vector<int>{0, 0, 0}));
    EXPECT_EQ(Labels((SpeakerArrangement(7) << 40) | 3), (std::vector<int>{100, 101}));
}

TEST(SpeakerArrangements, LayoutsBecomeSetsOrFallBackOnTheirCount)
{
    EXPECT_EQ(ArrangementOfLayout(Layout({100, 101})), 0x3U);
    EXPECT_EQ(ArrangementOfLayout(Layout({101, 100})), 0x3U);
    EXPECT_EQ(ArrangementOfLayout(Layout({0})), 0x80000U);
    EXPECT_EQ(ArrangementOfLayout(Layout({142, 102})), 0x100000004U);
    EXPECT_EQ(ArrangementOfLayout(Layout({100, 100})), 0x3U);
    EXPECT_EQ(ArrangementOfLayout(Layout({7})), 0x80000U);
    EXPECT_EQ(ArrangementOfLayout(Layout({0, 0, 0, 0})), 0x33U);
    EXPECT_EQ(ArrangementOfLayout(Layout({1, 2, 3, 4, 5, 6})), 0x3fU);
    EXPECT_EQ(ArrangementOfLayout(Layout({0, 1, 2, 3, 4, 5, 6, 7})), 0xffU);
    EXPECT_EQ(ArrangementOfLayout(Layout({7, 8, 9})), 0U);
    EXPECT_EQ(ArrangementOfLayout({}), 0U);
}

TEST(SpeakerArrangements, NamesAreThePublishedOnes)
{
    struct Case
    {
        SpeakerArrangement arrangement;
        const char16_t* name;
    };
    for (const Case& expected :
         {Case{SpeakerArr::kMono, u"Mono"}, Case{SpeakerArr::k51, u"5.1"}, Case{0xf00000, u"BFormat"},
          Case{SpeakerArr::k71Proximity, u"7.1 Proximity"}, Case{SpeakerArr::k71CineSideFill, u"7.1 Music (Dolby)"},
          Case{SpeakerArr::k222, u"22.2"}, Case{SpeakerArr::kStereoSurround, u"Stereo (Ls Rs)"},
          Case{0x6f03f, u"10.2 Experimental"}, Case{0, u""}, Case{0x1, u""}})
        EXPECT_TRUE(ArrangementName(expected.arrangement) == expected.name) << expected.arrangement;
}
