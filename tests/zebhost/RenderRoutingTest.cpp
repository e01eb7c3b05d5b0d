#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

#include <cmath>

namespace zebtest
{

namespace
{

using testing::HasSubstr;

constexpr std::size_t kFrames = 4000;

class RenderRoutingTest : public ZebhostTest
{
protected:
    Sound Render(const char* effect, const Sound& input, std::vector<std::string> options) const
    {
        WriteSound(Path("in.wav"), input);
        options.insert(options.begin(), {"render", EffectBundle(effect).string(), Path("in.wav"), Path("out.wav"),
                                         "--overwrite", "--tail", "0"});
        mLast = Run(options);
        EXPECT_EQ(mLast.code, 0) << mLast.err;
        return ReadSound(Path("out.wav"));
    }

    static std::vector<int> Delayed(const std::vector<int>& row, std::size_t frames)
    {
        std::vector<int> result(frames, 0);
        result.insert(result.end(), row.begin(), row.end());
        return result;
    }

    mutable RunResult mLast;
};

TEST_F(RenderRoutingTest, AStereoEffectOnAPairLeavesTheOtherChannelsAlignedAndUntouched)
{
    const Sound input = MakeNoise(6, kFrames);
    for (const char* lookAhead : {"Look-ahead=128", "Look-ahead=0", "Look-ahead=3001"})
    {
        const Sound output =
            Render("ZebDelay", input, {"--on", "Ls,Rs", "--set", "Mix=100", "--set", "Time=10", "--set", lookAhead});
        ASSERT_EQ(output.channels.size(), 6U);
        for (const std::size_t channel : {0U, 1U, 2U, 3U})
        {
            EXPECT_TRUE(output.channels[channel] == input.channels[channel]) << lookAhead << channel;
        }
        // Nothing but the repeat, which comes 10 ms later.
        const std::vector<int> repeat(output.channels[4].begin() + 480, output.channels[4].begin() + 960);
        const std::vector<int> source(input.channels[4].begin(), input.channels[4].begin() + 480);
        EXPECT_TRUE(repeat == source) << lookAhead;
        EXPECT_TRUE(output.channels[4][0] == 0 && output.channels[5][0] == 0);
    }
}

TEST_F(RenderRoutingTest, UntrimmedChannelsAreAllDelayedAlike)
{
    const Sound input = MakeNoise(6, kFrames);
    const Sound output = Render("ZebDelay", input, {"--on", "L,R", "--set", "Mix=0", "--no-trim"});
    for (std::size_t channel = 0; channel < 6; ++channel)
    {
        EXPECT_TRUE(output.channels[channel] == Delayed(input.channels[channel], 128)) << channel;
    }
}

TEST_F(RenderRoutingTest, ChannelsMayBeNumbersAndInAnyOrder)
{
    const Sound input = MakeNoise(4, kFrames);
    const Sound output = Render("ZebView", input, {"--on", "4,2", "--norm", "Balance=0"});
    // The balance stands on its first channel, which is the file's fourth.
    EXPECT_TRUE(output.channels[3] == input.channels[3]);
    EXPECT_TRUE(output.channels[1] == std::vector<int>(kFrames, 0));
    EXPECT_TRUE(output.channels[0] == input.channels[0]);
    EXPECT_TRUE(output.channels[2] == input.channels[2]);
}

TEST_F(RenderRoutingTest, AnEffectThatTakesFewerChannelsTakesThoseThatFit)
{
    const Sound input = MakeNoise(6, kFrames);
    const Sound output = Render("ZebDelay", input, {"--set", "Mix=100"});
    EXPECT_THAT(mLast.err, HasSubstr("works on L, R of L, R, C, LFE, Ls, Rs"));
    for (const std::size_t channel : {2U, 3U, 4U, 5U})
    {
        EXPECT_TRUE(output.channels[channel] == input.channels[channel]) << channel;
    }
    EXPECT_FALSE(output.channels[0] == input.channels[0]);
}

TEST_F(RenderRoutingTest, AnEffectThatTakesAllChannelsGetsAll)
{
    const Sound input = MakeNoise(6, kFrames);
    const Sound output = Render("ZebGain", input, {"--set", "Gain=-inf"});
    for (const std::vector<int>& row : output.channels)
    {
        EXPECT_TRUE(row == std::vector<int>(kFrames, 0));
    }
}

TEST_F(RenderRoutingTest, ASingleChannelFeedsBothInputsOfAStereoEffect)
{
    const Sound input = MakeNoise(1, kFrames);
    // The balance refuses mono.
    const Sound output = Render("ZebView", input, {});
    EXPECT_TRUE(output.channels == input.channels);
    EXPECT_THAT(mLast.err, HasSubstr("takes no single channel"));
    const Sound one = MakeNoise(3, kFrames);
    const Sound onOne = Render("ZebView", one, {"--on", "C"});
    EXPECT_TRUE(onOne.channels == one.channels);
}

TEST_F(RenderRoutingTest, SixteenChannelsPassThroughAStereoEffect)
{
    const Sound input = MakeNoise(16, 1000);
    const Sound output = Render("ZebDelay", input, {"--on", "15,16", "--set", "Mix=0"});
    EXPECT_TRUE(output.channels == input.channels);
}

TEST_F(RenderRoutingTest, ChannelsThatAreNotThereAreRefused)
{
    WriteSound(Path("in.wav"), MakeNoise(2, 100));
    for (const char* channels : {"Ls,Rs", "0", "3", "L,L", "L,", ""})
    {
        const RunResult result = Run({"render", EffectBundle("ZebGain").string(), Path("in.wav"), Path("out.wav"),
                                      std::string("--on=") + channels});
        EXPECT_EQ(result.code, 2) << channels << result.err;
    }
    WriteSound(Path("in.wav"), MakeNoise(6, 100));
    const RunResult many =
        Run({"render", EffectBundle("ZebDelay").string(), Path("in.wav"), Path("out.wav"), "--on", "1,2,3"});
    EXPECT_EQ(many.code, 1);
    EXPECT_THAT(many.LastLine(), HasSubstr("takes 2 channels"));
}

double Level(const std::vector<float>& row)
{
    double sum = 0;
    for (const float sample : row)
    {
        sum += static_cast<double>(sample) * static_cast<double>(sample);
    }
    return std::sqrt(sum / static_cast<double>(row.size()));
}

TEST_F(RenderRoutingTest, TheSideChainFileDrivesTheCompressor)
{
    const Sound input = MakeNoise(2, 20000);
    Sound silence = input;
    silence.channels.assign(2, std::vector<int>(20000, 0));
    WriteSound(Path("silence.wav"), silence);
    WriteSound(Path("loud.wav"), input);
    WriteSound(Path("loud-mono.wav"), MakeNoise(1, 20000));
    const std::vector<std::string> hard = {"--set", "Threshold=-40", "--set", "Ratio=20"};
    const auto level = [&](const char* sideChain)
    {
        std::vector<std::string> options = hard;
        options.insert(options.end(), {"--side-chain", Path(sideChain)});
        return Level(Render("ZebCompressor", input, options).floats[0]);
    };
    const double untouched = Level(Render("ZebGain", input, {}).floats[0]);
    EXPECT_NEAR(level("silence.wav"), untouched, untouched * 0.001);
    EXPECT_LT(level("loud.wav"), untouched / 10);
    EXPECT_LT(level("loud-mono.wav"), untouched / 10);
}

TEST_F(RenderRoutingTest, ASideChainWorksOnAPairToo)
{
    const Sound input = MakeNoise(6, 8000);
    WriteSound(Path("loud.wav"), MakeNoise(2, 4000)); // shorter than the input: silence follows
    const Sound output =
        Render("ZebCompressor", input, {"--on", "Ls,Rs", "--side-chain", Path("loud.wav"), "--set", "Threshold=-40"});
    EXPECT_TRUE(output.channels[0] == input.channels[0]);
    EXPECT_TRUE(output.channels[3] == input.channels[3]);
    EXPECT_FALSE(output.channels[4] == input.channels[4]);
}

TEST_F(RenderRoutingTest, ASideChainThatCannotBeIsRefused)
{
    WriteSound(Path("in.wav"), MakeNoise(2, 100));
    Sound other = MakeNoise(2, 100);
    other.rate = 44100;
    WriteSound(Path("other-rate.wav"), other);
    const RunResult none = Run({"render", EffectBundle("ZebGain").string(), Path("in.wav"), Path("out.wav"),
                                "--side-chain", Path("in.wav")});
    EXPECT_EQ(none.code, 1);
    EXPECT_THAT(none.LastLine(), HasSubstr("no side-chain input"));
    const RunResult rate = Run({"render", EffectBundle("ZebCompressor").string(), Path("in.wav"), Path("out.wav"),
                                "--side-chain", Path("other-rate.wav")});
    EXPECT_EQ(rate.code, 1);
    EXPECT_THAT(rate.LastLine(), HasSubstr("44100"));
    EXPECT_EQ(Files(), (std::vector<std::string>{"in.wav", "other-rate.wav"}));
}

} // namespace

} // namespace zebtest
