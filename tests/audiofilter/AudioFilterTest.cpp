// A filter's life, parameters and ticks.
#include "foundation/zebcore/MainThreadLoop.h"
#include "tests/audiofilter/RecordingFilter.h"
#include "utility/ThreadUtils.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <thread>

namespace zebaudiofilterhost
{
namespace
{

using testing::Buffers;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::MakeFilter;
using testing::ParameterCall;
using testing::RecordingFilter;

class AudioFilterTest : public ::testing::Test
{
protected:
    AudioFilterTest()
    {
        InitializeMainThreadID();
        zebcore::threads::SetMainThreadClock([this] { return mNow; });
    }

    ~AudioFilterTest() override
    {
        Tick();
        zebcore::threads::SetMainThreadClock({});
    }

    void Tick()
    {
        mNow += 20000000ULL;
        zebcore::threads::PumpMainThread();
    }

    unsigned long long mNow = 1;
};

TEST_F(AudioFilterTest, BareFilterReportsSilenceAndLeavesBuffersAlone)
{
    boost::intrusive_ptr<AudioFilter> filter(new AudioFilter(u"id", u"name"));
    Buffers in(2, 4);
    Buffers out(2, 4);
    out.Fill(0.5F);
    for (const bool mapped : {false, true})
    {
        filter->SetUseChannelMap(mapped);
        filter->Resume();
        ChannelFlags flags;
        filter->ProcessWithMapping(in.Pointers(), out.Pointers(), 4, ChannelFlags(), flags);
        EXPECT_EQ(flags.Value(), ~0ULL);
        EXPECT_EQ(out.Channel(1)[3], 0.5F);
    }
}

TEST_F(AudioFilterTest, BareFilterHasHarmlessAnswers)
{
    boost::intrusive_ptr<AudioFilter> filter(new AudioFilter(u"id", u"name"));
    EXPECT_EQ(filter->GetMaxProcessingBlockSize(), 2147483647);
    EXPECT_EQ(filter->GetParameterCount(), 0);
    EXPECT_FALSE(filter->GetParameterInfo(-1));
    EXPECT_TRUE(filter->GetFactoryPresetName(-1).empty());
    EXPECT_FALSE(filter->CreateCustomEditor());
    EXPECT_EQ(filter->GetProcessedScale(), 1.0);
    EXPECT_TRUE(filter->OfflineProcessFinished());
    filter->SetCurrentDuration(3.5);
    EXPECT_EQ(filter->GetProcessedDuration(), 3.5);
    EXPECT_TRUE(filter->GetMainTargetBus().GetType() == AudioFilterBusDescription::kBusType_Main);
    EXPECT_TRUE(filter->GetSideChainTargetBus().GetType() == AudioFilterBusDescription::kBusType_SideChain);
    EXPECT_TRUE(filter->GetID() == u"id" && filter->GetDisplayName() == u"name");
}

TEST_F(AudioFilterTest, PostedParameterReachesASuspendedFilterAtTheNextTick)
{
    const auto filter = MakeFilter({2}, {2});
    filter->PostSetParameter(3, 0.25F);
    EXPECT_THAT(filter->mParameterCalls, IsEmpty());
    Tick();
    EXPECT_THAT(filter->mParameterCalls, ElementsAre(ParameterCall{3, 0.25F, true}));
    EXPECT_EQ(filter->GetParameterDirtyCount(), 1U);
}

TEST_F(AudioFilterTest, PostedParameterOfARunningFilterWaitsForTheBlock)
{
    const auto filter = MakeFilter({}, {});
    filter->Resume();
    filter->PostSetParameter(0, 1.0F);
    Tick();
    EXPECT_THAT(filter->mParameterCalls, IsEmpty());
    std::thread(
        [&filter]
        {
            ChannelFlags flags;
            filter->ProcessWithMapping(nullptr, nullptr, 0, ChannelFlags(), flags);
        })
        .join();
    EXPECT_THAT(filter->mParameterCalls, ElementsAre(ParameterCall{0, 1.0F, false}));
}

TEST_F(AudioFilterTest, ResumeRunsWhatWaitsBeforeItStarts)
{
    const auto filter = MakeFilter({}, {});
    filter->PostSetParameter(0, 1.0F);
    filter->Resume();
    EXPECT_EQ(filter->mParameterCalls.size(), 1U);
    filter->Suspend();
    filter->PostSetParameter(0, 0.5F); // Nothing happens before the next flush
    EXPECT_EQ(filter->mParameterCalls.size(), 1U);
    filter->FlushMessageQueue();
    EXPECT_EQ(filter->mParameterCalls.size(), 2U);
}

TEST_F(AudioFilterTest, AFilterMadeOffTheMainThreadGetsNoTicks)
{
    boost::intrusive_ptr<RecordingFilter> filter;
    std::thread([&filter] { filter = MakeFilter({}, {}); }).join();
    filter->PostSetParameter(0, 1.0F);
    Tick();
    EXPECT_THAT(filter->mParameterCalls, IsEmpty());
    filter->Resume();
    EXPECT_EQ(filter->mParameterCalls.size(), 1U);
}

TEST_F(AudioFilterTest, APostedParameterKeepsTheFilterAliveAndItsTickSurvivesTheEnd)
{
    bool destroyed = false;
    auto filter = MakeFilter({}, {});
    filter->mDestroyed = &destroyed;
    for (int i = 0; i < 3; ++i)
        filter->PostSetParameter(i, 1.0F);
    const auto neighbour = MakeFilter({}, {});
    neighbour->PostSetParameter(0, 1.0F);
    filter.reset();
    EXPECT_FALSE(destroyed);
    Tick();
    EXPECT_TRUE(destroyed);
    EXPECT_EQ(neighbour->mParameterCalls.size(), 1U);
}

TEST_F(AudioFilterTest, ATickPassesByAFilterThatIsBeingMadeOrDestroyed)
{
    struct Ticking : public AudioFilter
    {
        explicit Ticking(int& ticks) : AudioFilter(u"id", u"name"), mTicks(ticks) {}
        void OnUITimerTick() override { ++mTicks; }
        int& mTicks;
    };
    int ticks = 0;
    auto unheld = std::make_unique<Ticking>(ticks);
    Tick();
    EXPECT_EQ(ticks, 0);
    const boost::intrusive_ptr<AudioFilter> held(unheld.release());
    Tick();
    EXPECT_EQ(ticks, 1);
}

TEST_F(AudioFilterTest, AutomatedParameterIsSetBeforeTheSignal)
{
    const auto filter = MakeFilter({}, {});
    filter->mParameters.resize(2);
    std::vector<std::pair<int, float>> heard;
    filter->ConnectAutomatedParameterChange(
        [&](int index, float value)
        {
            EXPECT_EQ(filter->GetParameter(index), value);
            heard.emplace_back(index, value);
        });
    filter->SetParameterAutomated(1, 0.75F);
    EXPECT_THAT(heard, ElementsAre(std::pair(1, 0.75F)));
    filter->SetParameter(1, 0.5F);
    EXPECT_EQ(heard.size(), 1U);
}

TEST_F(AudioFilterTest, ParameterStringIsThePlainNumber)
{
    const auto filter = MakeFilter({}, {});
    filter->mParameters = {0.25F, 1.0F, 1.0F / 3.0F};
    EXPECT_TRUE(filter->GetParameterString(0) == u"0.25");
    EXPECT_TRUE(filter->GetParameterString(1) == u"1");
    EXPECT_TRUE(filter->GetParameterString(2) == u"0.333333");
    EXPECT_TRUE(filter->GetParameterString(-1) == u"0");
}

TEST_F(AudioFilterTest, SignalsTellStatesAndGestures)
{
    const auto filter = MakeFilter({}, {});
    std::vector<bool> suspended;
    std::vector<std::pair<int, bool>> gestures;
    filter->ConnectSuspendedStateChanged([&](bool state) { suspended.push_back(state); });
    filter->ConnectEditingStateChange([&](int index, bool begin) { gestures.emplace_back(index, begin); });
    filter->Resume();
    filter->Suspend();
    filter->BeginEditing(4);
    filter->EndEditing(4);
    EXPECT_THAT(suspended, ElementsAre(false, true));
    EXPECT_THAT(gestures, ElementsAre(std::pair(4, true), std::pair(4, false)));
}

TEST_F(AudioFilterTest, ASlotMayDropTheLastPointerOfAnotherFilterDuringATick)
{
    auto victim = MakeFilter({}, {});
    const auto killer = MakeFilter({}, {});
    killer->ConnectAutomatedParameterChange([&](int, float) { victim.reset(); });
    struct Automating : public Message
    {
        explicit Automating(AudioFilter& target) : mTarget(target) {}
        bool ExecuteOnProcessThread() override
        {
            mTarget.SetParameterAutomated(0, 0.0F);
            return true;
        }
        AudioFilter& mTarget;
    };
    killer->Post(boost::intrusive_ptr<Message>(new Automating(*killer)));
    Tick();
    EXPECT_FALSE(victim);
}

} // namespace
} // namespace zebaudiofilterhost
