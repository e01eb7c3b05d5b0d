// Blocks through the channel maps.
#include "foundation/zebcore/Trace.h"
#include "tests/audiofilter/FloatingPointControl.h"
#include "tests/audiofilter/RecordingFilter.h"
#include "utility/ThreadUtils.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cfenv>
#include <limits>
#include <stdexcept>
#include <string>

namespace zebaudiofilterhost
{
namespace
{

using testing::Buffers;
using ::testing::Each;
using ::testing::ElementsAre;
using testing::MakeBus;
using testing::MakeFilter;
using testing::MakeMap;
using testing::RecordingFilter;

constexpr int kFrames = 8;
constexpr auto kInput = AudioFilter::kDirection_Input;
constexpr auto kOutput = AudioFilter::kDirection_Output;

class RenderingTest : public ::testing::Test
{
protected:
    RenderingTest() { InitializeMainThreadID(); }

    // A running filter with maps in use; maps are given as application channel to plug-in channel.
    void Start(const std::vector<int>& inputs, const std::vector<int>& outputs, int mainChannels,
               const std::map<int, int>& inputMap, const std::map<int, int>& outputMap, int latency = 0)
    {
        mFilter = MakeFilter(inputs, outputs);
        mFilter->mLatency = latency;
        mFilter->SetBlockSize(kFrames);
        mFilter->SetMainTargetBus(MakeBus(mainChannels));
        mFilter->SetUseChannelMap(true);
        mFilter->SetChannelMap(MakeMap(kChannels, inputMap), kInput);
        mFilter->SetChannelMap(MakeMap(kChannels, outputMap), kOutput);
        mFilter->Resume();
    }

    const testing::ProcessCall& Block(unsigned long long inFlags = 0)
    {
        mFilter->ProcessWithMapping(mIn.Pointers(), mOut.Pointers(), kFrames, ChannelFlags(inFlags), mFlags);
        return mFilter->mProcessCalls.back();
    }

    static constexpr int kChannels = 70;

    boost::intrusive_ptr<RecordingFilter> mFilter;
    Buffers mIn{kChannels, kFrames};
    Buffers mOut{kChannels, kFrames};
    ChannelFlags mFlags{0xDEADULL};
};

TEST_F(RenderingTest, ConnectedChannelsArePassedWithoutACopy)
{
    Start({2}, {2}, 4, {{1, 0}, {3, 1}}, {{2, 0}, {0, 1}});
    const auto& call = Block();
    EXPECT_THAT(call.in, ElementsAre(mIn.Channel(1), mIn.Channel(3)));
    EXPECT_THAT(call.out, ElementsAre(mOut.Channel(2), mOut.Channel(0)));
    EXPECT_EQ(call.inFlags.Value(), ~0b11ULL);
    EXPECT_EQ(call.frames, kFrames);
}

TEST_F(RenderingTest, EditsWhileMapsAreOffDoNotReachTheArrays)
{
    Start({1}, {1}, 2, {{0, 0}}, {{0, 0}});
    mFilter->SetUseChannelMap(false);
    mFilter->SetChannelMap(MakeMap(2, {{1, 0}}), kInput);
    mFilter->SetUseChannelMap(true);
    EXPECT_EQ(Block().in[0], mIn.Channel(0));
}

TEST_F(RenderingTest, ANewBlockSizeRebuildsNothingBeforeResume)
{
    Start({1}, {1}, 2, {{0, 0}}, {{0, 0}}, kFrames);
    mIn.Fill(1.0F);
    Block();
    mFilter->SetBlockSize(4 * kFrames);
    Block();
    EXPECT_EQ(mOut.Channel(1)[0], 1.0F); // Still the old line with its content
}

TEST_F(RenderingTest, SilentAndUnconnectedInputsGetSilence)
{
    Start({3}, {1}, 4, {{1, 0}, {3, 1}}, {{0, 0}});
    const auto& call = Block(0b0010); // Application channel 1 is silent
    EXPECT_EQ(call.inFlags.Value(), ~0b010ULL);
    EXPECT_EQ(call.in[1], mIn.Channel(3));
    EXPECT_EQ(call.in[0], call.in[2]);
    EXPECT_THAT(std::vector<float>(call.in[0], call.in[0] + kFrames), Each(0.0F));
}

TEST_F(RenderingTest, UnconnectedOutputsShareABufferOfTheirOwn)
{
    Start({1}, {3}, 2, {{0, 0}}, {{1, 1}});
    const auto& call = Block();
    EXPECT_EQ(call.out[1], mOut.Channel(1));
    EXPECT_EQ(call.out[0], call.out[2]);
    for (int channel = 0; channel < kChannels; ++channel)
        EXPECT_NE(call.out[0], mOut.Channel(channel));
    EXPECT_NE(call.out[0], call.in[0]);
}

TEST_F(RenderingTest, FlagsCountChannelsModulo64)
{
    Start({1}, {1}, kChannels, {{66, 0}}, {{0, 0}});
    EXPECT_EQ(Block(1ULL << 2).in[0] == mIn.Channel(66), false); // Shares its bit with channel 2
    EXPECT_EQ(Block(~(1ULL << 2)).in[0], mIn.Channel(66));

    Start({66}, {1}, kChannels, {{1, 65}}, {{0, 0}});
    EXPECT_EQ(Block().inFlags.Value(), ~(1ULL << 1)); // Plug-in input 65
}

TEST_F(RenderingTest, WithoutMapsTheApplicationsPointersGoToThePlugIn)
{
    mFilter = MakeFilter({2}, {2});
    mFilter->SetBlockSize(kFrames);
    EXPECT_EQ(Block().inFlags.Value(), ~0ULL); // Before the first Resume
    mFilter->Resume();
    const auto& call = Block(0b10);
    EXPECT_EQ(call.in[0], mIn.Channel(0));
    EXPECT_NE(call.in[1], mIn.Channel(1));
    EXPECT_EQ(call.inFlags.Value(), ~0b01ULL);
    EXPECT_EQ(call.outArray, mOut.Pointers());
}

TEST_F(RenderingTest, AGeneratorGetsTheInputsAsTheyCome)
{
    Start({}, {1}, 2, {{0, 0}}, {{0, 0}});
    const auto& call = Block(0b101);
    EXPECT_EQ(call.inArray, mIn.Pointers());
    EXPECT_EQ(call.inFlags.Value(), 0b101ULL);
}

TEST_F(RenderingTest, AnalysersWithoutOutputsLeavePassingChannelsAlone)
{
    Start({1}, {}, 2, {{0, 0}}, {});
    mOut.Fill(0.25F);
    const auto& call = Block();
    EXPECT_EQ(call.outArray, mOut.Pointers());
    EXPECT_EQ(mOut.Channel(1)[0], 0.25F);
    EXPECT_EQ(mFlags.Value(), 0b01ULL); // It only feeds the plug-in
}

TEST_F(RenderingTest, ResultFlagsArePlugInNumbersButForChannelsThatPassOrOnlyFeed)
{
    Start({1}, {1}, 4, {{3, 0}, {2, 0}}, {{2, 0}}); // Of two slots on one input the later feeds; both are connected
    mFilter->mOutFlagsToReport = ChannelFlags(0b0011);
    mOut.Fill(0.5F);
    Block();
    // 0 and 1 pass by and are cleared, 2 is written, 3 only feeds and is marked.
    EXPECT_EQ(mFlags.Value(), 0b1000ULL);
    EXPECT_EQ(mOut.Channel(3)[0], 0.5F);
    EXPECT_EQ(mOut.Channel(2)[0], 0.5F);
    EXPECT_EQ(mOut.Channel(0)[0], 0.0F);
}

TEST_F(RenderingTest, PassingChannelsAreDelayedByTheLatency)
{
    for (const int latency : {0, 3, kFrames, 29})
    {
        Start({1}, {1}, 3, {{1, 0}}, {{1, 0}}, latency);
        float written = 0.0F;
        float expected = static_cast<float>(-latency);
        for (int block = 0; block < 20; ++block)
        {
            for (int i = 0; i < kFrames; ++i)
                mIn.Channel(2)[i] = ++written;
            mFilter->mOutFlagsToReport = ChannelFlags(~0ULL);
            Block();
            EXPECT_FALSE(mFlags.IsSet(0b101));
            for (int i = 0; i < kFrames; ++i)
            {
                ++expected;
                ASSERT_EQ(mOut.Channel(2)[i], std::max(expected, 0.0F)) << "latency " << latency;
            }
        }
    }
}

TEST_F(RenderingTest, PassingChannelsMayExchangeTheirBuffers)
{
    for (const int latency : {0, 1})
    {
        Start({1}, {1}, 4, {{3, 0}}, {{3, 0}}, latency);
        for (int channel = 0; channel < 3; ++channel)
            std::fill_n(mIn.Channel(channel), kFrames, static_cast<float>(channel + 1));
        float** const in = mIn.Pointers();
        std::array<float*, kChannels> out{};
        std::copy_n(mOut.Pointers(), kChannels, out.begin());
        std::copy_n(in, 3, out.begin());
        std::rotate(out.begin(), out.begin() + 1, out.begin() + 3);
        mFilter->ProcessWithMapping(in, out.data(), kFrames, ChannelFlags(), mFlags);
        EXPECT_EQ(out[0][kFrames - 1], 1.0F) << latency;
        EXPECT_EQ(out[1][kFrames - 1], 2.0F) << latency;
        EXPECT_EQ(out[2][kFrames - 1], 3.0F) << latency;
    }
}

TEST_F(RenderingTest, ImpossibleLatenciesCountAsNoneAndAreTraced)
{
    std::string traced;
    zebcore::debug::SetTraceSink([&traced](std::string_view text) { traced.append(text); });
    zebcore::debug::SetTraceCategoryEnabled("AudioFilter::BuildChannelMaps", true);
    for (const int latency : {-1, 48000 * 60 + 1, std::numeric_limits<int>::max()})
    {
        traced.clear();
        Start({1}, {1}, 2, {{0, 0}}, {{0, 0}});
        mFilter->Suspend();
        mFilter->SetSampleRate(48000.0F);
        mFilter->mLatency = latency;
        mFilter->Resume();
        mIn.Channel(1)[0] = 0.75F;
        Block();
        EXPECT_EQ(mOut.Channel(1)[0], 0.75F);
        EXPECT_NE(traced.find(std::to_string(latency)), std::string::npos);
    }
    zebcore::debug::SetAllTraceEnabled(false);
    zebcore::debug::SetTraceSink({});
}

TEST_F(RenderingTest, LabelsBeyondTheTargetsOrThePlugInAreIgnored)
{
    Start({4}, {4}, 2, {{0, 2}, {1, 3}}, {{0, 2}, {1, 1}});
    const auto call = Block();
    EXPECT_EQ(call.inFlags.Value(), ~0ULL); // 2 and 3 lie beyond a main target of two and no side chain
    EXPECT_EQ(call.out[1], mOut.Channel(1));
    EXPECT_EQ(call.out[2], call.out[3]); // 2 lies beyond the main target

    mFilter->SetSideChainTargetBus(MakeBus(1));
    mFilter->UpdateChannelMapArraysForRendering();
    EXPECT_EQ(Block().in[2], mIn.Channel(0));
    EXPECT_NE(Block().out[2], mOut.Channel(0)); // The side chain does not widen the outputs
}

TEST_F(RenderingTest, EditsReachARunningFilter)
{
    Start({2}, {2}, 4, {{0, 0}, {1, 1}}, {{0, 0}, {1, 1}});
    mFilter->AssignChannelMapping(kInput, 1, 3);
    mFilter->RemoveChannelMapping(kInput, 0);
    const auto call = Block();
    EXPECT_EQ(call.in[1], mIn.Channel(3));
    EXPECT_EQ(call.inFlags.Value(), ~0b10ULL);
    EXPECT_EQ(mFlags.Value() & 0b1111, 0b1000ULL); // 3 feeds only, 2 passes by, 0 and 1 are written
}

TEST_F(RenderingTest, EditsReachARunningFilterWhoseMapsWereTheIdentity)
{
    const std::map<int, int> identity = {{0, 0}, {1, 1}};
    const std::map<int, int> swapped = {{0, 1}, {1, 0}};
    Start({2}, {2}, 2, identity, identity);
    for (int round = 0; round < 2; ++round)
    {
        mFilter->SetChannelMap(MakeMap(2, swapped), kInput);
        EXPECT_THAT(Block().in, ElementsAre(mIn.Channel(1), mIn.Channel(0)));
        EXPECT_THAT(Block().out, ElementsAre(mOut.Channel(0), mOut.Channel(1)));
        mFilter->SetChannelMap(MakeMap(2, swapped), kOutput);
        EXPECT_THAT(Block().out, ElementsAre(mOut.Channel(1), mOut.Channel(0)));
        mFilter->SetChannelMap(MakeMap(2, identity), kInput);
        mFilter->SetChannelMap(MakeMap(2, identity), kOutput);
        EXPECT_THAT(Block().in, ElementsAre(mIn.Channel(0), mIn.Channel(1)));
        EXPECT_THAT(Block().out, ElementsAre(mOut.Channel(0), mOut.Channel(1)));
        EXPECT_EQ(Block(0b10).inFlags.Value(), ~0b01ULL);
        EXPECT_NE(Block(0b10).in[1], mIn.Channel(1)); // Silence of its own
    }
}

TEST_F(RenderingTest, AChannelThatComesToPassBringsWhatItPlayedBefore)
{
    for (const int latency : {0, kFrames})
    {
        Start({2}, {2}, 2, {{0, 0}, {1, 1}}, {{0, 0}, {1, 1}}, latency);
        mIn.Fill(1.0F);
        Block();
        mFilter->RemoveChannelMapping(kInput, 1);
        mFilter->RemoveChannelMapping(kOutput, 1);
        mIn.Fill(2.0F);
        mOut.Fill(0.0F);
        Block();
        EXPECT_EQ(mOut.Channel(1)[0], latency == 0 ? 2.0F : 1.0F) << latency;
    }
}

TEST_F(RenderingTest, EditsOfASuspendedFilterWaitForResume)
{
    Start({1}, {1}, 2, {{0, 0}}, {{0, 0}});
    mFilter->Suspend();
    mFilter->AssignChannelMapping(kInput, 0, 1);
    EXPECT_EQ(Block().in[0], mIn.Channel(0));
    mFilter->Resume();
    EXPECT_EQ(Block().in[0], mIn.Channel(1));
}

TEST_F(RenderingTest, ATargetThatGrowsWhileRunningChangesNothingThatDoesNotFit)
{
    Start({1}, {1}, 2, {{0, 0}}, {{0, 0}});
    mFilter->SetMainTargetBus(MakeBus(6));
    mFilter->SetChannelMap(MakeMap(6, {{5, 0}}), kInput);
    mOut.Fill(0.5F);
    const auto call = Block();
    EXPECT_EQ(call.in[0], mIn.Channel(5));
    EXPECT_EQ(mOut.Channel(1)[0], 0.0F); // Still passes
    EXPECT_EQ(mOut.Channel(4)[0], 0.5F); // Not known before the next Resume
    mFilter->Suspend();
    mFilter->Resume();
    Block();
    EXPECT_EQ(mOut.Channel(4)[0], 0.0F);
}

TEST_F(RenderingTest, ResumeStartsTheDelayAnew)
{
    Start({1}, {1}, 2, {{0, 0}}, {{0, 0}}, kFrames);
    mIn.Fill(1.0F);
    Block();
    mFilter->Suspend();
    mFilter->Resume();
    Block();
    EXPECT_EQ(mOut.Channel(1)[0], 0.0F);
    Block();
    EXPECT_EQ(mOut.Channel(1)[0], 1.0F);
}

TEST_F(RenderingTest, SizesFollowAtResumeAndStaleArraysAreNotUsed)
{
    Start({4}, {4}, 4, {{0, 0}}, {{0, 0}});
    mFilter->Suspend();
    mFilter->ClearBusConfiguration();
    mFilter->AddInputBus(MakeBus(1));
    mFilter->SetUseChannelMap(false);
    mFilter->Resume();
    EXPECT_EQ(Block().in[0], mIn.Channel(0));
    mFilter->SetUseChannelMap(true); // Too early: the arrays of the four channels are still there
    EXPECT_EQ(Block().in[0], mIn.Channel(0));
}

TEST_F(RenderingTest, QueuedParametersComeBeforeTheBlock)
{
    struct Probe : public RecordingFilter
    {
        Probe() : RecordingFilter({}, {}) {}
        void Process(float**, float**, int, ChannelFlags, ChannelFlags&) override { mSeen = mParameterCalls.size(); }
        std::size_t mSeen = 99;
    };
    boost::intrusive_ptr<Probe> filter(new Probe);
    filter->Resume();
    filter->PostSetParameter(0, 0.5F);
    filter->ProcessWithMapping(nullptr, nullptr, 0, ChannelFlags(), mFlags);
    filter->FlushMessageQueue(); // Until then the message holds the filter
    EXPECT_EQ(filter->mSeen, 1U);
    EXPECT_EQ(mFlags.Value(), 0U);
}

// A filter that throws at every change of its parameter 1, having changed how its thread computes.
struct ParameterThrower : public RecordingFilter
{
    ParameterThrower() : RecordingFilter({}, {}) {}
    void SetParameter(int index, float value) override
    {
        RecordingFilter::SetParameter(index, value);
        if (index == 1)
        {
            testing::SetFloatingPointWord(testing::GetFloatingPointWord() ^ testing::kFlushAndRoundDown);
            throw std::runtime_error("parameter");
        }
    }
};

// On the process thread while the filter runs, on the main thread while it does not.
TEST_F(RenderingTest, AQueuedParameterThatThrowsComesOnceAndIsNotKept)
{
    const testing::FloatingPointRestorer restorer;
    bool destroyed = false;
    boost::intrusive_ptr<ParameterThrower> filter(new ParameterThrower);
    filter->mDestroyed = &destroyed;
    const auto process = [&]
    {
        filter->ProcessWithMapping(nullptr, nullptr, 0, ChannelFlags(), mFlags);
    };
    for (const bool running : {true, false})
    {
        filter->mParameterCalls.clear();
        running ? filter->Resume() : filter->Suspend();
        for (const int index : {0, 1, 2})
            filter->PostSetParameter(index, 0.5F);
        const auto mode = testing::GetFloatingPointMode();
        if (running)
            EXPECT_THROW(process(), std::runtime_error);
        else
            EXPECT_THROW(filter->FlushMessageQueue(), std::runtime_error);
        EXPECT_EQ(filter->mParameterCalls.size(), 2U) << running;
        if (running)
        {
            EXPECT_EQ(testing::GetFloatingPointMode(), mode);
            process();
        }
        filter->FlushMessageQueue();
        EXPECT_EQ(filter->mParameterCalls.size(), 3U) << running;
    }
    filter.reset();
    EXPECT_TRUE(destroyed) << "no message holds it";
}

// A filter that changes how its thread computes, divides by zero, and leaves it at that.
struct ModeChanger : public RecordingFilter
{
    explicit ModeChanger(bool throws) : RecordingFilter({}, {}), mThrows(throws) {}
    void Process(float**, float**, int, ChannelFlags, ChannelFlags&) override
    {
        testing::SetFloatingPointWord(testing::GetFloatingPointWord() ^ testing::kFlushAndRoundDown);
        std::feraiseexcept(FE_DIVBYZERO);
        if (mThrows)
            throw std::runtime_error("process");
    }

    const bool mThrows;
};

TEST_F(RenderingTest, TheCallersFloatingPointModeOutlastsABlock)
{
    const testing::FloatingPointRestorer restorer;
    for (const bool throws : {false, true})
    {
        boost::intrusive_ptr<ModeChanger> filter(new ModeChanger(throws));
        filter->Resume();
        // The second time with what the plug-in takes away, and set between two blocks.
        for (int block = 0; block < 2; ++block)
        {
            const auto mode = testing::GetFloatingPointMode();
            std::feclearexcept(FE_ALL_EXCEPT);
            const auto process = [&]
            {
                filter->ProcessWithMapping(nullptr, nullptr, 0, ChannelFlags(), mFlags);
            };
            if (throws)
                EXPECT_THROW(process(), std::runtime_error);
            else
                process();
            EXPECT_EQ(testing::GetFloatingPointMode(), mode) << throws << block;
            EXPECT_NE(std::fetestexcept(FE_DIVBYZERO), 0) << "what was met is no mode";
            testing::SetFloatingPointWord(testing::GetFloatingPointWord() ^ testing::kFlushAndRoundDown);
        }
    }
}

} // namespace
} // namespace zebaudiofilterhost
