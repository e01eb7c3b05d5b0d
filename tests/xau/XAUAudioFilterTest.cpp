#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gmock/gmock.h>

#include <limits>
#include <thread>

namespace zebaudiofilterhost::xau
{
namespace
{

using testing::ElementsAre;

class XAUAudioFilterTest : public testing::Test
{
protected:
    TestClock mClock;
    FakeUnit mUnit;
};

TEST_F(XAUAudioFilterTest, IsMadeOfItsIDWithAndWithoutPrefix)
{
    for (const UTF16String& id : {u"4:" + mUnit.GetID(), mUnit.GetID()})
    {
        const auto filter = XAUAudioFilter::Create(id);
        ASSERT_TRUE(filter);
        EXPECT_EQ(filter->GetID(), u"4:" + mUnit.GetID());
        EXPECT_EQ(filter->GetDisplayName(), u"Fake");
        EXPECT_EQ(filter->GetMaxProcessingBlockSize(), 1024);
        EXPECT_TRUE(filter->HasCustomEditor());
        EXPECT_TRUE(filter->DoPresetsUseChunkData());
    }
    EXPECT_FALSE(XAUAudioFilter::Create(u"4:1 2 3"));
    mUnit.mGivesInstance = false;
    EXPECT_FALSE(XAUAudioFilter::Create(u"4:" + mUnit.GetID()));
}

// Rates before sizes before initialisation; what needs it is done while the unit is not initialised.
TEST_F(XAUAudioFilterTest, CallsTheUnitInOrder)
{
    {
        const auto filter = mUnit.MakeFilter();
        EXPECT_THAT(mUnit.mCalls,
                    ElementsAre("create", "set 27 0 0", "set 8 1 0", "set 8 2 0", "set 14 0 0", "initialize"));
        mUnit.mCalls.clear();
        filter->SetSampleRate(96000.0F);
        EXPECT_THAT(mUnit.mCalls, ElementsAre("uninitialize", "set 8 1 0", "set 8 2 0", "initialize"));
        mUnit.mCalls.clear();
        filter->SetSampleRate(96000.0F);
        filter->SetBlockSize(512);
        EXPECT_THAT(mUnit.mCalls, testing::IsEmpty());
        filter->SetBlockSize(4096);
        EXPECT_THAT(mUnit.mCalls, ElementsAre("uninitialize", "set 14 0 0", "initialize"));
        EXPECT_EQ(mUnit.Read<UInt32>(Global(kAudioUnitProperty_MaximumFramesPerSlice)), 1024U);
        mUnit.mCalls.clear();
        filter->Resume();
        filter->Suspend();
        EXPECT_THAT(mUnit.mCalls, ElementsAre("set 23 1 0", "reset 0 0"));
        mUnit.mCalls.clear();
    }
    EXPECT_THAT(mUnit.mCalls, ElementsAre("uninitialize", "close"));
}

TEST_F(XAUAudioFilterTest, SetsTheRateOfEveryElementAndKeepsTheRest)
{
    mUnit.SetElements(kAudioUnitScope_Input, {2, 7});
    const auto filter = mUnit.MakeFilter();
    filter->SetSampleRate(96000.0F);
    const auto format = mUnit.Read<AudioStreamBasicDescription>(FormatOf(kAudioUnitScope_Input, 1));
    EXPECT_EQ(format.mSampleRate, 96000.0);
    EXPECT_EQ(format.mChannelsPerFrame, 7U);
    filter->SetSampleRate(std::numeric_limits<float>::quiet_NaN());
    mUnit.mCalls.clear();
    filter->SetSampleRate(std::numeric_limits<float>::quiet_NaN());
    EXPECT_FALSE(mUnit.mCalls.empty()) << "no rate is the same as this one";
}

TEST_F(XAUAudioFilterTest, AFailedInitialisationIsTriedAgainByResume)
{
    mUnit.mInitializeResult = kAudioUnitErr_FailedInitialization;
    const auto filter = mUnit.MakeFilter();
    EXPECT_FALSE(filter->IsAUInitialized());
    mUnit.mInitializeResult = noErr;
    filter->Resume();
    EXPECT_TRUE(filter->IsAUInitialized());
    filter->InitializeAU();
    EXPECT_EQ(mUnit.CountCalls("initialize"), 2U);
    filter->UninitializeAU();
    filter->UninitializeAU();
    EXPECT_EQ(mUnit.CountCalls("uninitialize"), 1U);
}

TEST_F(XAUAudioFilterTest, ResumeResetsOnceForEachInput)
{
    mUnit.SetElements(kAudioUnitScope_Input, {1, 1, 1});
    const auto filter = mUnit.MakeFilter();
    filter->Resume();
    EXPECT_EQ(mUnit.CountCalls("reset 0 0") + mUnit.CountCalls("reset 0 1") + mUnit.CountCalls("reset 0 2"), 3U);
}

TEST_F(XAUAudioFilterTest, LatencyIsReadEachTimeInFramesOfTheRate)
{
    const auto filter = mUnit.MakeFilter();
    EXPECT_EQ(filter->GetInitialDelay(), 0) << "it cannot be read";
    for (const auto& [seconds, frames] : std::map<Float64, int>{{0.01, 441}, {0.00001, 0}, {1e300, 0}, {0.5, 22050}})
    {
        mUnit.Answer(Global(kAudioUnitProperty_Latency), seconds);
        EXPECT_EQ(filter->GetInitialDelay(), frames) << seconds;
    }
    mUnit.Answer(Global(kAudioUnitProperty_Latency), std::numeric_limits<Float64>::quiet_NaN());
    EXPECT_EQ(filter->GetInitialDelay(), 0);
    filter->SetSampleRate(48000.0F);
    mUnit.Answer(Global(kAudioUnitProperty_Latency), Float64{0.25});
    EXPECT_EQ(filter->GetInitialDelay(), 12000);
}

TEST_F(XAUAudioFilterTest, BlockSizesBelowZeroAreZero)
{
    const auto filter = mUnit.MakeFilter();
    filter->SetBlockSize(-1);
    EXPECT_EQ(mUnit.Read<UInt32>(Global(kAudioUnitProperty_MaximumFramesPerSlice)), 0U);
}

TEST_F(XAUAudioFilterTest, ManyElementsAreALie)
{
    mUnit.Answer({kAudioUnitProperty_ElementCount, kAudioUnitScope_Input, 0}, UInt32{0xFFFFFFFF});
    const auto filter = mUnit.MakeFilter();
    EXPECT_LT(filter->GetElementCount(kAudioUnitScope_Input), 1000U);
    filter->BuildIOConfiguration();
    EXPECT_EQ(filter->GetInputBuses().size(), 1U);
    EXPECT_EQ(filter->GetElementCount(kAudioUnitScope_Note), 0U);
}

// Its events come on that thread; it may be freed on any other.
TEST_F(XAUAudioFilterTest, OutlivesTheThreadThatMadeIt)
{
    mUnit.SetParameters({5}, 0.0F, 10.0F);
    boost::intrusive_ptr<XAUAudioFilter> filter;
    std::thread([&] { filter = mUnit.MakeFilter(); }).join();
    ASSERT_TRUE(filter);
    filter->SetParameter(0, 0.5F); // the listener is told, and nobody passes it on
    filter.reset();
    EXPECT_EQ(mUnit.CountCalls("close"), 1U);
}

class XAUListeningTest : public XAUAudioFilterTest
{
protected:
    void SetUp() override
    {
        mUnit.SetParameters({5, 6}, 0.0F, 10.0F);
        mFilter = mUnit.MakeFilter();
        ASSERT_TRUE(mFilter);
        mFilter->ConnectEditingStateChange(
            [this](int index, bool starts)
            { mHeard.push_back((starts ? "begin " : "end ") + std::to_string(index)); });
        mFilter->GetAutomatedParameterChangeSignal().connect(
            [this](int index, float value)
            { mHeard.push_back(std::to_string(index) + "=" + std::to_string(value).substr(0, 3)); });
    }

    void Tell(AudioUnitEventType type, AudioUnitParameterID id, AudioUnitScope scope = kAudioUnitScope_Global) const
    {
        AudioUnitEvent event = {};
        event.mEventType = type;
        event.mArgument.mParameter = {mUnit.GetInstance(), id, scope, 0};
        EXPECT_EQ(AUEventListenerNotify(nullptr, nullptr, &event), noErr);
    }

    boost::intrusive_ptr<XAUAudioFilter> mFilter;
    std::vector<std::string> mHeard;
};

TEST_F(XAUListeningTest, ChangesAndGesturesBecomeSignals)
{
    Tell(kAudioUnitEvent_BeginParameterChangeGesture, 0);
    mUnit.mValues[{kAudioUnitScope_Global, 6}] = 5.0F;
    Tell(kAudioUnitEvent_ParameterValueChange, 6);
    Tell(kAudioUnitEvent_EndParameterChangeGesture, 0);
    Tell(kAudioUnitEvent_ParameterValueChange, 99); // no parameter of the unit
    Tell(kAudioUnitEvent_ParameterValueChange, 5, kAudioUnitScope_Input);
    mClock.Pass(50);
    EXPECT_THAT(mHeard, ElementsAre("begin -1", "1=0.5", "end -1"));
}

TEST_F(XAUListeningTest, ASetParameterIsHeardByWhoeverListens)
{
    mFilter->SetParameter(0, 0.2F);
    EXPECT_EQ((mUnit.mValues[{kAudioUnitScope_Global, 5}]), 2.0F);
    mClock.Pass(50);
    EXPECT_THAT(mHeard, ElementsAre("0=0.2"));
    mFilter->SetParameter(7, 0.5F);
    mFilter->SetParameter(-1, 0.5F);
    mClock.Pass(50);
    EXPECT_EQ(mHeard.size(), 1U);
}

TEST_F(XAUListeningTest, OtherEventsAndNoneAreNothing)
{
    AudioUnitEvent event = {};
    event.mEventType = 17;
    mFilter->EventListenerProc(nullptr, &event, 0, 0.0F);
    mFilter->EventListenerProc(nullptr, nullptr, 0, 0.0F);
    EXPECT_THAT(mHeard, testing::IsEmpty());
    Tell(kAudioUnitEvent_ParameterValueChange, 5);
    mFilter.reset();
    mClock.Pass(50);
    EXPECT_THAT(mHeard, testing::IsEmpty()) << "heard by a filter that is gone";
}

} // namespace
} // namespace zebaudiofilterhost::xau
