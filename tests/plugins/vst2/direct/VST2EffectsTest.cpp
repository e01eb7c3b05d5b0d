// What the VST 2 example effects promise, called without our library in between.
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/vst2/direct/DirectVST2.h"

#include <cmath>
#include <cstring>
#include <gtest/gtest.h>

namespace
{

using namespace zebtest;
using namespace zebaudiofilterhost::vst;

VST2Channels Impulses(std::size_t frames)
{
    VST2Channels channels(2, std::vector<float>(frames));
    channels[0][0] = 1.0F;
    channels[1][1] = 0.5F;
    return channels;
}

bool SetText(DirectVST2& plugin, std::int32_t index, std::string text)
{
    return plugin.Call(effString2Parameter, index, 0, text.data()) != 0;
}

class ZebGain2 : public testing::TestWithParam<const char*>
{
protected:
    DirectVST2 mGain{VST2Effect(GetParam())};
};

TEST_P(ZebGain2, PassesEveryBitAtItsDefaultAndFollowsItsText)
{
    ASSERT_NE(mGain.effect, nullptr);
    EXPECT_EQ(mGain.effect->magic, kEffectMagic);
    mGain.Resume(48000.0F, 8);
    EXPECT_EQ(mGain.Process(Impulses(8)), Impulses(8));
    for (const char* text : {"-inf", "-71.0", "-6.0", "0.0", "12.5", "24.0"})
    {
        EXPECT_TRUE(SetText(mGain, 0, text));
        EXPECT_EQ(mGain.Text(effGetParamDisplay, 0), text);
    }
    SetText(mGain, 0, "-6 dB");
    EXPECT_NEAR(mGain.Process(Impulses(8))[0][0], std::pow(10.0, -6.0 / 20.0), 1e-6);
    SetText(mGain, 1, "On");
    EXPECT_EQ(mGain.Process(Impulses(8)), Impulses(8));
    EXPECT_FALSE(SetText(mGain, 0, "loud"));
}

TEST_P(ZebGain2, TakesMonoStereoAndFiveOneAndNothingElse)
{
    EXPECT_EQ(mGain.effect->numInputs, 2);
    for (const auto& [type, channels] :
         {std::pair{kSpeakerArrMono, 1}, std::pair{kSpeakerArr51, 6}, std::pair{kSpeakerArrStereo, 2}})
    {
        EXPECT_TRUE(mGain.Arrange(type, channels));
        EXPECT_EQ(mGain.effect->numOutputs, channels);
        EXPECT_FALSE(mGain.Arrange(type, channels + 1));
        EXPECT_EQ(mGain.effect->numInputs, channels);
        VstSpeakerArrangement* in = nullptr;
        VstSpeakerArrangement* out = nullptr;
        EXPECT_EQ(mGain.Call(effGetSpeakerArrangement, 0, reinterpret_cast<long long>(&in), &out), 1);
        ASSERT_TRUE(in != nullptr && out != nullptr);
        EXPECT_EQ(in->numChannels, channels);
        EXPECT_EQ(out->type, type);
    }
    EXPECT_FALSE(mGain.Arrange(kSpeakerArrUserDefined, 3));
}

INSTANTIATE_TEST_SUITE_P(Forms, ZebGain2, testing::Values("ZebGain2", "ZebGain2Plain"));

TEST(ZebShell2, MakesTheMemberThatTheHostWants)
{
    std::vector<std::int32_t> members;
    {
        DirectVST2 shell(VST2Effect("ZebShell2"));
        EXPECT_EQ(shell.Call(effGetPlugCategory), kPlugCategShell);
        std::string name(64, '\0');
        while (const long long id = shell.Call(effShellGetNextPlugin, 0, 0, name.data()))
            members.push_back(static_cast<std::int32_t>(id));
    }
    ASSERT_EQ(members.size(), 3U);
    const VST2Channels in{{1.0F}, {0.5F}};
    const VST2Channels expected[] = {{{-1.0F}, {-0.5F}}, {{0.5F}, {1.0F}}, {{0.75F}, {0.75F}}};
    for (std::size_t i = 0; i < members.size(); ++i)
    {
        DirectVST2 member(VST2Effect("ZebShell2"), members[i]);
        ASSERT_NE(member.effect, nullptr);
        EXPECT_EQ(member.effect->uniqueID, members[i]);
        EXPECT_NE(member.Call(effGetPlugCategory), kPlugCategShell);
        EXPECT_EQ(member.Process(in), expected[i]);
        member.effect->setParameter(member.effect, 0, 0.0F);
        EXPECT_EQ(member.Process(in), in);
    }
    EXPECT_EQ(DirectVST2(VST2Effect("ZebShell2"), 12345).effect, nullptr);
}

VST2Channels Rendered(DirectVST2& echo)
{
    echo.Resume(1000.0F, 400);
    return echo.Process(Impulses(400));
}

TEST(ZebEcho2, ItsProgramsSoundDifferentAndAChunkHoldsOne)
{
    DirectVST2 echo(VST2Effect("ZebEcho2"));
    EXPECT_EQ(echo.effect->numPrograms, 4);
    EXPECT_EQ(echo.Text(effGetProgramNameIndexed, 2), "Canyon");
    EXPECT_EQ(Rendered(echo)[0][90], 0.3F); // "Slap" repeats after 90 ms
    echo.Call(effSetProgram, 0, 1);
    echo.effect->setParameter(echo.effect, 0, 0.1F);
    const VST2Channels second = Rendered(echo);
    EXPECT_EQ(second[0][100], 0.35F);

    DirectVST2 other(VST2Effect("ZebEcho2"));
    EXPECT_TRUE(other.SetChunk(true, echo.Chunk(true)));
    EXPECT_EQ(other.Call(effGetProgram), 0);
    EXPECT_EQ(Rendered(other), second);
    EXPECT_TRUE(other.SetChunk(false, echo.Chunk(false)));
    EXPECT_EQ(other.Call(effGetProgram), 1);
    EXPECT_EQ(Rendered(other), second);
}

TEST(ZebEcho2, ADamagedChunkChangesNothing)
{
    DirectVST2 echo(VST2Effect("ZebEcho2"));
    const std::string good = echo.Chunk(true);
    std::string otherKind = good;
    otherKind[0] = 'X';
    std::string otherProgram = good;
    otherProgram[4] = 77;
    for (const std::string& bad : {std::string(), good.substr(1), good + '\0', otherKind, otherProgram})
        EXPECT_FALSE(echo.SetChunk(true, bad));
    EXPECT_EQ(echo.Chunk(true), good);

    std::string notANumber = good;
    const float nan = NAN;
    std::memcpy(&notANumber[8], &nan, sizeof(nan));
    EXPECT_TRUE(echo.SetChunk(true, notANumber));
    EXPECT_EQ(echo.effect->getParameter(echo.effect, 0), 0.0F);
}

TEST(ZebPanel2, WidensWhatDiffersBetweenTheChannels)
{
    DirectVST2 panel(VST2Effect("ZebPanel2"));
    EXPECT_EQ(panel.Process({{1.0F}, {0.5F}}), (VST2Channels{{1.0F}, {0.5F}}));
    panel.effect->setParameter(panel.effect, 0, 0.0F);
    EXPECT_EQ(panel.Process({{1.0F}, {0.5F}}), (VST2Channels{{0.75F}, {0.75F}}));
    EXPECT_TRUE(SetText(panel, 0, "200 %"));
    EXPECT_EQ(panel.Process({{1.0F}, {0.5F}}), (VST2Channels{{1.25F}, {0.25F}}));
}

} // namespace
