#include "host/src/XAU/src/XAUChannelCounts.h"
#include "host/src/XAU/src/XAUChannelLayouts.h"
#include "tests/xau/support/CFTestObjects.h"
#include "tests/xau/support/FakeUnit.h"

#include <gmock/gmock.h>

namespace zebaudiofilterhost::xau
{
namespace
{

using Pairs = std::vector<AUChannelInfo>;

struct Negotiation
{
    const char* name;
    Pairs pairs;
    ChannelCounts wanted;
    ChannelCounts given;
};

void PrintTo(const Negotiation& negotiation, std::ostream* out)
{
    *out << negotiation.name;
}

class XAUChannelCountsTest : public testing::TestWithParam<Negotiation>
{
};

TEST_P(XAUChannelCountsTest, ChoosesWhatServesTheRequestBest)
{
    const ChannelCounts given = NegotiateChannelCounts(GetParam().pairs, GetParam().wanted);
    EXPECT_EQ(given.mInputs, GetParam().given.mInputs);
    EXPECT_EQ(given.mOutputs, GetParam().given.mOutputs);
}

INSTANTIATE_TEST_SUITE_P(
    Requests, XAUChannelCountsTest,
    testing::Values(Negotiation{"ThePairItself", {{1, 1}, {2, 2}}, {2, 2}, {2, 2}},
                    Negotiation{"ADirectMatchBehindAFittingOne", {{4, 4}, {2, 2}}, {2, 2}, {2, 2}},
                    Negotiation{"AnyAsManyOnBothSides", {{-1, -1}}, {2, 2}, {2, 2}},
                    Negotiation{"AnyAsManyFitsUnequalOnes", {{-1, -1}}, {1, 2}, {1, 2}},
                    Negotiation{"AnyAndAnyOther", {{-1, -2}}, {5, 3}, {5, 3}},
                    Negotiation{"AnyOtherTheWrongWayRound", {{-2, -1}}, {2, 3}, {2, 3}},
                    Negotiation{"AnyOtherTheWrongWayRoundIsUpToTwo", {{-2, -1}}, {3, 3}, {2, 3}},
                    Negotiation{"UpToEight", {{-8, -8}}, {4, 4}, {4, 4}},
                    Negotiation{"MoreThanUpToEight", {{-8, -8}}, {12, 12}, {8, 8}},
                    Negotiation{"MonoOnly", {{1, 1}}, {2, 2}, {1, 1}},
                    Negotiation{"Generator", {{0, 2}}, {2, 2}, {0, 2}},
                    Negotiation{"TheFirstWithRoom", {{1, 1}, {6, 6}, {4, 4}}, {2, 2}, {6, 6}},
                    Negotiation{"AnyInputIntoStereo", {{-1, 2}}, {1, 2}, {1, 2}},
                    Negotiation{"RoomOnOneSideOnly", {{1, 4}, {4, 1}}, {2, 2}, {1, 4}},
                    Negotiation{"TheLargestWhereNoneHasRoom", {{1, 1}, {1, 2}, {2, 2}, {2, 1}}, {3, 3}, {2, 2}}),
    testing::PrintToStringParamName());

TEST(XAUChannelLayouts, EachLabelHasItsCounterpart)
{
    const std::vector<std::pair<UInt32, int>> labels = {
        {1, 100},   {2, 101},   {3, 102},   {4, 103},  {5, 104},   {6, 105},   {7, 107},  {8, 108},  {9, 106},
        {10, 109},  {11, 110},  {12, 111},  {13, 112}, {14, 114},  {15, 113},  {16, 115}, {17, 117}, {18, 116},
        {33, 129},  {34, 130},  {35, 118},  {36, 119}, {37, 131},  {38, 132},  {39, 133}, {42, 0},   {200, 134},
        {201, 135}, {202, 136}, {203, 137}, {204, 0},  {301, 100}, {302, 101}, {0, 0},    {19, 0},   {0xFFFFFFFF, 0}};
    for (const auto& [theirs, ours] : labels)
        EXPECT_EQ(static_cast<int>(TranslateLabel(theirs)), ours) << theirs;
}

TEST(XAUChannelLayouts, EachTagHasAsManyChannelsAsItSays)
{
    int known = 0;
    for (UInt32 number = 100; number <= 160; ++number)
    {
        for (UInt32 channels = 1; channels <= 24; ++channels)
        {
            const ChannelLayout layout = TranslateTag(number << 16 | channels);
            if (layout.empty())
                continue;
            ++known;
            EXPECT_EQ(layout.size(), channels) << number;
        }
    }
    EXPECT_EQ(known, 47);
    for (const UInt32 tag : {0x660002U, 0x840004U, 0x8b0006U, 0x930005U, 0x950004U, 0x640002U, 0x9b0005U})
        EXPECT_TRUE(TranslateTag(tag).empty()) << tag;
}

// A request, and what the buses say afterwards.
class XAUIOConfigurationTest : public testing::Test
{
protected:
    static std::vector<int> Labels(const ChannelLayout& layout)
    {
        std::vector<int> labels;
        for (const auto& channel : layout)
            labels.push_back(static_cast<int>(channel.GetLabel()));
        return labels;
    }

    void Request(std::size_t inputs, std::size_t outputs)
    {
        if (!mFilter)
            mFilter = mUnit.MakeFilter();
        ASSERT_TRUE(mFilter);
        mFilter->RequestIOConfiguration({ChannelLayout(inputs)}, {ChannelLayout(outputs)});
    }

    void AnswerLayout(AudioUnitElement element, const std::vector<UInt32>& words)
    {
        mUnit.AnswerList({kAudioUnitProperty_AudioChannelLayout, kAudioUnitScope_Input, element}, words);
    }

    // Of the first input; also whether there is one.
    bool ReadLayout(ChannelLayout& layout)
    {
        if (!mFilter)
            mFilter = mUnit.MakeFilter();
        return mFilter->GetAudioChannelLayout(kAudioUnitScope_Input, 0, layout);
    }

    FakeUnit mUnit;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
};

TEST_F(XAUIOConfigurationTest, AsksForPlainFloatsInTheNegotiatedNumber)
{
    mUnit.AnswerList(Global(kAudioUnitProperty_SupportedNumChannels), Pairs{{1, 2}});
    Request(1, 2);
    const auto format = mUnit.Read<AudioStreamBasicDescription>(FormatOf(kAudioUnitScope_Input));
    EXPECT_EQ(format.mSampleRate, 44100.0);
    EXPECT_EQ(format.mFormatID, 0x6C70636DU);
    EXPECT_EQ(format.mFormatFlags, 0x29U);
    EXPECT_EQ(format.mBytesPerPacket, 4U);
    EXPECT_EQ(format.mFramesPerPacket, 1U);
    EXPECT_EQ(format.mBytesPerFrame, 4U);
    EXPECT_EQ(format.mChannelsPerFrame, 1U);
    EXPECT_EQ(format.mBitsPerChannel, 32U);
    EXPECT_EQ(mUnit.GetChannels(kAudioUnitScope_Output, 0), 2U);
    EXPECT_EQ(mFilter->GetNumberOfInputChannels(), 1);
    EXPECT_EQ(mFilter->GetNumberOfOutputChannels(), 2);
    EXPECT_TRUE(mFilter->IsAUInitialized());
}

TEST_F(XAUIOConfigurationTest, OddRequestsAndAnEmptyListChangeNothing)
{
    mUnit.SetElements(kAudioUnitScope_Input, {4});
    mFilter = mUnit.MakeFilter();
    mFilter->RequestIOConfiguration({ChannelLayout(2), ChannelLayout(2)}, {ChannelLayout(2)});
    mFilter->RequestIOConfiguration({ChannelLayout(2)}, {});
    mUnit.AnswerList(Global(kAudioUnitProperty_SupportedNumChannels), Pairs{});
    mFilter->RequestIOConfiguration({ChannelLayout(2)}, {ChannelLayout(2)});
    EXPECT_EQ(mUnit.GetChannels(kAudioUnitScope_Input, 0), 4U);
    EXPECT_EQ(mFilter->GetNumberOfInputChannels(), 0) << "no buses were built";
}

TEST_F(XAUIOConfigurationTest, AUnitWithoutAListIsAskedForTheRequest)
{
    Request(3, 5);
    EXPECT_EQ(mUnit.GetChannels(kAudioUnitScope_Input, 0), 3U);
    EXPECT_EQ(mUnit.GetChannels(kAudioUnitScope_Output, 0), 5U);
}

TEST_F(XAUIOConfigurationTest, BusesTellTheTruthAfterARefusal)
{
    mFilter = mUnit.MakeFilter();
    mUnit.mRefused = {FormatOf(kAudioUnitScope_Input)};
    Request(1, 1);
    EXPECT_EQ(mFilter->GetNumberOfInputChannels(), 2);
    EXPECT_EQ(mFilter->GetNumberOfOutputChannels(), 2) << "the output is not asked once the input has refused";
    mUnit.mRefused = {FormatOf(kAudioUnitScope_Output)};
    Request(1, 1);
    EXPECT_EQ(mFilter->GetNumberOfInputChannels(), 1);
    EXPECT_EQ(mFilter->GetNumberOfOutputChannels(), 2);
    EXPECT_TRUE(mFilter->IsAUInitialized());
}

TEST_F(XAUIOConfigurationTest, LayoutsAreReadInEveryForm)
{
    struct Case
    {
        const char* name;
        std::vector<UInt32> words; // tag, bitmap, count, and five words for each description
        std::vector<int> labels;
        bool isKnown;
    };
    mUnit.SetElements(kAudioUnitScope_Input, {3});
    const std::vector<int> fallback = {0, 0, 0};
    for (const Case& c :
         {Case{"descriptions", {0, 0, 2, 3, 0, 0, 0, 0, 301, 0, 0, 0, 0}, {102, 100}, true},
          Case{"a count beyond the bytes", {0, 0, 3, 3, 0, 0, 0, 0, 301, 0, 0, 0, 0}, fallback, true},
          Case{"a huge count", {0, 0, 0xFFFFFFFF, 3, 0, 0, 0, 0}, fallback, true},
          Case{"no descriptions", {0, 0, 0}, fallback, true},
          Case{"a bitmap", {0x10000, 0x20005, 0}, {100, 102, 116}, true},
          Case{"a bitmap of unknown bits", {0x10000, 0xFFFC0000, 0}, {}, true},
          Case{"a tag", {0x720003, 0, 0}, {102, 100, 101}, true},
          Case{"a tag of many",
               {0x920015, 0, 0},
               {100, 101, 102, 114, 109, 110, 104, 105, 112, 113, 118, 119, 0, 106, 103, 131, 107, 108, 0, 0, 0},
               true},
          Case{"an unknown tag", {0x840004, 0, 0}, fallback, true},
          Case{"too few bytes", {0x650002, 0}, fallback, true}, Case{"no bytes", {}, fallback, true}})
    {
        AnswerLayout(0, c.words);
        ChannelLayout layout(9);
        EXPECT_EQ(ReadLayout(layout), c.isKnown) << c.name;
        EXPECT_EQ(Labels(layout), c.labels) << c.name;
    }
}

TEST_F(XAUIOConfigurationTest, WithoutALayoutTheFormatTells)
{
    for (const auto& [channels, labels] :
         std::map<UInt32, std::vector<int>>{{1, {0}}, {2, {100, 101}}, {3, {0, 0, 0}}, {0, {}}})
    {
        mUnit.SetElements(kAudioUnitScope_Input, {channels});
        ChannelLayout layout(9);
        EXPECT_EQ(ReadLayout(layout), channels != 0);
        EXPECT_EQ(Labels(layout), labels);
    }
    mUnit.Forget(FormatOf(kAudioUnitScope_Input));
    ChannelLayout layout(9);
    EXPECT_FALSE(ReadLayout(layout));
    EXPECT_TRUE(layout.empty());
}

TEST_F(XAUIOConfigurationTest, BusesHaveTheElementsNamesAndReleaseThem)
{
    mUnit.SetElements(kAudioUnitScope_Input, {2, 1, 0, 2});
    mUnit.SetElements(kAudioUnitScope_Output, {2, 1});
    const CFOwner name(MakeString("Voice"));
    CFRetain(name.get()); // for whoever reads it
    mUnit.Answer({kAudioUnitProperty_ElementName, kAudioUnitScope_Input, 1}, name.get());
    mFilter = mUnit.MakeFilter();
    mFilter->BuildIOConfiguration();
    EXPECT_EQ(CFGetRetainCount(name.get()), 1);
    std::vector<UTF16String> names;
    for (const AudioFilterBusDescription& bus : mFilter->GetInputBuses())
        names.push_back(bus.GetName());
    EXPECT_THAT(names, testing::ElementsAre(u"Input", u"Voice", u"Aux"));
    EXPECT_EQ(mFilter->GetNumberOfInputChannels(), 5);
    EXPECT_EQ(mFilter->GetNumberOfOutputChannels(), 3);
}

TEST_F(XAUIOConfigurationTest, ABitmapOfNoChannelsIsABusOfNone)
{
    AnswerLayout(0, {0x10000, 0, 0});
    mFilter = mUnit.MakeFilter();
    mFilter->BuildIOConfiguration();
    EXPECT_EQ(mFilter->GetInputBuses().size(), 1U);
    EXPECT_EQ(mFilter->GetNumberOfInputChannels(), 0);
}

} // namespace
} // namespace zebaudiofilterhost::xau
