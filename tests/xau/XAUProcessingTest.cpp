#include "foundation/zebcore/Trace.h"
#include "tests/xau/support/FakeUnit.h"

#include <gmock/gmock.h>

#include <array>
#include <limits>

namespace zebaudiofilterhost::xau
{
namespace
{

using Row = std::vector<float>;

class Host final : public IAudioFilterHost
{
public:
    bool GetTimeInfo(utility::TimecodeFormat&, int&, int&) const override { return false; }
    bool GetTempo(utility::Tempo& tempo) const override
    {
        EXPECT_EQ(tempo.mTempo, 0.0);
        tempo.mTempo = 90.0;
        tempo.mNumerator = 3;
        tempo.mDenominator = 8;
        return false; // which is not looked at
    }
    bool GetTransportState(bool&, bool&, bool&) const override { return false; }
};

// An AudioBufferList of any length.
struct Buffers
{
    explicit Buffers(std::size_t count) : mMemory(sizeof(AudioBufferList) + count * sizeof(AudioBuffer))
    {
        Get().mNumberBuffers = static_cast<UInt32>(count);
    }
    AudioBufferList& Get() { return *reinterpret_cast<AudioBufferList*>(mMemory.data()); }
    AudioBuffer& operator[](std::size_t index) { return Get().mBuffers[index]; }

    std::vector<std::byte> mMemory;
};

class XAUProcessingTest : public testing::Test
{
protected:
    void Start()
    {
        mFilter = mUnit.MakeFilter();
        ASSERT_TRUE(mFilter);
        mFilter->BuildIOConfiguration();
        mFilter->Resume();
        mUnit.mCalls.clear();
    }

    void Process(int frames)
    {
        mInput.resize(static_cast<std::size_t>(mFilter->GetNumberOfInputChannels()));
        mOutput.assign(static_cast<std::size_t>(mFilter->GetNumberOfOutputChannels()),
                       Row(static_cast<std::size_t>(frames), -1.0F));
        std::vector<float*> in;
        std::vector<float*> out;
        for (std::size_t channel = 0; channel < mInput.size(); ++channel)
        {
            mInput[channel].resize(static_cast<std::size_t>(frames));
            for (std::size_t frame = 0; frame < mInput[channel].size(); ++frame)
                mInput[channel][frame] = static_cast<float>(channel * 10000 + frame);
            in.push_back(mInput[channel].data());
        }
        for (Row& row : mOutput)
            out.push_back(row.data());
        ChannelFlags silent;
        silent.Set(1);
        mFilter->Process(in.data(), out.data(), frames, ChannelFlags(), silent);
        EXPECT_FALSE(silent.IsSet(1));
    }

    // Renders what the inputs of the bus have, into buffers of the unit's own.
    void RenderInput(UInt32 bus, UInt32 channels, bool withMemory)
    {
        mUnit.mRender = [=, this](UInt32 frames, AudioBufferList& data)
        {
            Buffers pulled(channels);
            mOwn.assign(channels, Row(frames, 77.0F));
            for (std::size_t channel = 0; channel < channels; ++channel)
                pulled[channel] = {9, 9, withMemory ? mOwn[channel].data() : nullptr};
            EXPECT_EQ(mUnit.Pull(bus, frames, pulled.Get()), noErr);
            for (std::size_t channel = 0; channel < std::min(channels, data.mNumberBuffers); ++channel)
            {
                EXPECT_EQ(pulled[channel].mNumberChannels, 1U);
                EXPECT_EQ(pulled[channel].mDataByteSize, frames * 4);
                data.mBuffers[channel].mData = pulled[channel].mData;
            }
            return noErr;
        };
    }

    FakeUnit mUnit;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
    std::vector<Row> mInput;
    std::vector<Row> mOutput;
    std::vector<Row> mOwn;
};

TEST_F(XAUProcessingTest, BlocksAreCutAndTimeMovesOn)
{
    Start();
    RenderInput(0, 2, true);
    Process(2500);
    EXPECT_THAT(mUnit.mCalls, testing::ElementsAre("render 1024", "render 1024", "render 452"));
    EXPECT_TRUE(mOutput == mInput);
    std::vector<double> times;
    for (const AudioTimeStamp& time : mUnit.mTimes)
    {
        times.push_back(time.mSampleTime);
        EXPECT_EQ(time.mHostTime, static_cast<UInt64>(time.mSampleTime));
        EXPECT_EQ(time.mRateScalar, 1.0);
        EXPECT_EQ(time.mFlags, 7U);
    }
    EXPECT_THAT(times, testing::ElementsAre(0.0, 1024.0, 2048.0));
    Process(0);
    EXPECT_EQ(mUnit.mCalls.size(), 3U);

    mFilter->SetCurrentOffset(9000);
    Process(10);
    EXPECT_EQ(mUnit.mTimes.back().mSampleTime, 9000.0);
    mFilter->SetCurrentOffset(9000); // the same: its own count goes on
    Process(10);
    EXPECT_EQ(mUnit.mTimes.back().mSampleTime, 9010.0);
    mFilter->SetCurrentOffset(-5);
    Process(10);
    EXPECT_EQ(mUnit.mTimes.back().mSampleTime, -5.0);
    mFilter->Suspend();
    mFilter->Resume();
    Process(10);
    EXPECT_EQ(mUnit.mTimes.back().mSampleTime, 0.0);
}

TEST_F(XAUProcessingTest, TheUnitBringsTheMemoryOfItsOutputs)
{
    mUnit.SetElements(kAudioUnitScope_Output, {2, 3});
    Start();
    int rounds = 0;
    mUnit.mRender = [&](UInt32, AudioBufferList& data)
    {
        ++rounds;
        EXPECT_EQ(data.mNumberBuffers, 5U);
        static std::array<float, 1024> sMemory = {42.0F};
        for (std::size_t channel = 0; channel < 5; ++channel)
        {
            EXPECT_EQ(data.mBuffers[channel].mNumberChannels, 1U);
            EXPECT_EQ(data.mBuffers[channel].mDataByteSize, 0U);
            EXPECT_EQ(data.mBuffers[channel].mData, nullptr);
        }
        data.mBuffers[4].mData = sMemory.data();
        data.mNumberBuffers = 1; // a lie that does not last
        return noErr;
    };
    Process(4);
    Process(4);
    EXPECT_EQ(rounds, 2);
    EXPECT_EQ(mOutput[4], (Row{42.0F, 0.0F, 0.0F, 0.0F}));
    EXPECT_EQ(mOutput[3], Row(4, -1.0F)) << "without memory the output stays";
}

TEST_F(XAUProcessingTest, AFailingRenderLeavesTheOutputsAndTheChunkIsOver)
{
    Start();
    int rounds = 0;
    mUnit.mRender = [&](UInt32 frames, AudioBufferList& data)
    {
        mOwn.assign(2, Row(frames, 5.0F));
        data.mBuffers[0].mData = mOwn[0].data();
        return ++rounds == 1 ? kAudioUnitErr_NoConnection : noErr;
    };
    Process(1025);
    EXPECT_EQ(rounds, 2);
    EXPECT_EQ(mOutput[0][1023], -1.0F);
    EXPECT_EQ(mOutput[0][1024], 5.0F);
    EXPECT_EQ(mUnit.mTimes.back().mSampleTime, 1024.0);
}

TEST_F(XAUProcessingTest, ARenderThatThrowsIsOneThatFails)
{
    Start();
    mUnit.mThrowsIn = {"render"};
    Process(1030);
    EXPECT_EQ(mOutput[0], Row(1030, -1.0F));
    EXPECT_EQ(mUnit.CountCalls("render 6"), 1U) << "the next chunk is another try";
    Buffers pulled(1);
    pulled[0] = {9, 9, nullptr};
    EXPECT_EQ(mUnit.Pull(0, 4, pulled.Get()), noErr);
    EXPECT_EQ(pulled[0].mData, nullptr) << "the inputs of a render that is over";
    mUnit.mThrowsIn.clear();
    RenderInput(0, 2, true);
    Process(8);
    EXPECT_EQ(mOutput, mInput);
}

// A unit asks for more than it was asked for: silence is behind the input, in whosever memory.
TEST_F(XAUProcessingTest, NoInputIsReadBeyondItsEnd)
{
    Start();
    for (const auto& [frames, withMemory] : {std::pair(20U, true), {20U, false}, {5000U, true}, {5000U, false}})
    {
        mUnit.mRender = [&, frames = frames, withMemory = withMemory](UInt32, AudioBufferList& data)
        {
            Buffers pulled(2);
            mOwn.assign(2, Row(frames, 77.0F));
            for (std::size_t channel = 0; channel < 2; ++channel)
                pulled[channel].mData = withMemory ? mOwn[channel].data() : nullptr;
            EXPECT_EQ(mUnit.Pull(0, frames, pulled.Get()), noErr);
            for (std::size_t channel = 0; channel < 2; ++channel)
            {
                const auto* sound = static_cast<const float*>(pulled[channel].mData);
                const std::size_t told = pulled[channel].mDataByteSize / sizeof(float);
                EXPECT_EQ(told, withMemory || frames <= kMaxChunk ? frames : kMaxChunk);
                EXPECT_EQ(sound[3], mInput[channel][3]);
                EXPECT_EQ(Row(sound + 4, sound + told), Row(told - 4, 0.0F));
            }
            data.mBuffers[0].mData = nullptr;
            return noErr;
        };
        Process(4);
    }
}

TEST_F(XAUProcessingTest, AUnitThatDoesNotInitializeIsNotRendered)
{
    mUnit.mInitializeResult = kAudioUnitErr_FailedInitialization;
    Start();
    Process(8);
    EXPECT_EQ(mOutput[0], Row(8, -1.0F));
    EXPECT_EQ(mUnit.CountCalls("render 8"), 0U);
}

// The arrays of the caller have as many channels as the buses that it sees.
TEST_F(XAUProcessingTest, NewBusesAreRenderedFromTheNextResumeOn)
{
    mUnit.SetElements(kAudioUnitScope_Input, {6});
    mUnit.SetElements(kAudioUnitScope_Output, {6});
    Start();
    RenderInput(0, 1, true);
    mFilter->RequestIOConfiguration({ChannelLayout(1)}, {ChannelLayout(1)});
    Process(8);
    EXPECT_EQ(mUnit.CountCalls("render 8"), 0U);
    EXPECT_EQ(mOutput, (std::vector<Row>{Row(8, -1.0F)}));
    mFilter->Resume();
    Process(8);
    EXPECT_EQ(mOutput, mInput);
}

TEST_F(XAUProcessingTest, BeforeTheFirstResumeNothingIsRendered)
{
    mFilter = mUnit.MakeFilter();
    mFilter->BuildIOConfiguration();
    Process(8);
    EXPECT_EQ(mOutput[0], Row(8, -1.0F));
    EXPECT_EQ(mUnit.CountCalls("render 8"), 0U);
}

// One input channel, then two: what each bus reads with and without memory of its own.
TEST_F(XAUProcessingTest, InputsOfLaterBusesAreOffsetOnlyIntoMemoryOfTheUnit)
{
    mUnit.SetElements(kAudioUnitScope_Input, {1, 2});
    Start();
    mFilter->SetSideChainTargetBus(
        AudioFilterBusDescription::CreateStereo(u"Side", AudioFilterBusDescription::kBusType_SideChain));
    mFilter->Resume();
    RenderInput(1, 2, true);
    Process(16);
    EXPECT_EQ(mOutput[0], mInput[1]);
    EXPECT_EQ(mOutput[1], mInput[2]);
    RenderInput(1, 2, false);
    Process(16);
    EXPECT_EQ(mOutput[0], mInput[0]) << "the offset must not count here";
    EXPECT_EQ(mOutput[1], mInput[1]);
    RenderInput(0, 5, false); // more than there are
    Process(16);
    EXPECT_EQ(mOutput[1], mInput[1]);
}

TEST_F(XAUProcessingTest, InputsThatAreNotThereAreSilent)
{
    mUnit.SetElements(kAudioUnitScope_Input, {1, 1});
    Start();
    mUnit.mRender = [&](UInt32 frames, AudioBufferList& data)
    {
        mOwn.assign(2, Row(frames, 77.0F));
        Buffers pulled(2);
        pulled[0].mData = mOwn[0].data();
        pulled[1].mData = mOwn[1].data();
        EXPECT_EQ(mFilter->RenderCallback(nullptr, nullptr, 1, frames, &pulled.Get()), noErr);
        data.mBuffers[0].mData = mOwn[0].data();
        data.mBuffers[1].mData = mOwn[1].data();
        return noErr;
    };
    Process(4);
    EXPECT_EQ(mOutput[0], mInput[1]);
    EXPECT_EQ(mOutput[1], Row(4, 0.0F)) << "the second channel behind the offset is none";
}

TEST_F(XAUProcessingTest, ABusThatIsNotKnownIsLeftAlone)
{
    Start();
    mUnit.mRender = [&](UInt32 frames, AudioBufferList& data)
    {
        Buffers pulled(1);
        pulled[0] = {9, 9, nullptr};
        EXPECT_EQ(mFilter->RenderCallback(nullptr, nullptr, 1, frames, &pulled.Get()), noErr);
        EXPECT_EQ(pulled[0].mNumberChannels, 9U);
        EXPECT_EQ(pulled[0].mData, nullptr);
        data.mBuffers[0].mData = nullptr;
        return noErr;
    };
    Process(4);
}

// The offsets of a second build stand behind the first ones, which go on counting.
TEST_F(XAUProcessingTest, OffsetsOfTheFirstBuildGoOnCounting)
{
    mUnit.SetElements(kAudioUnitScope_Input, {1, 1});
    mFilter = mUnit.MakeFilter();
    mFilter->BuildIOConfiguration();
    mUnit.SetElements(kAudioUnitScope_Input, {2, 2});
    mFilter->BuildIOConfiguration();
    mFilter->Resume();
    mUnit.mRender = [&](UInt32 frames, AudioBufferList& data)
    {
        mOwn.assign(3, Row(frames, 77.0F));
        // 0, 1 by the first build; 0, 2 by the second; no fifth one.
        const Row expected = {0.0F, 10000.0F, 0.0F, 20000.0F, 77.0F};
        for (UInt32 bus = 1; bus < 5; ++bus)
        {
            Buffers pulled(1);
            Row row(frames, 77.0F);
            pulled[0].mData = row.data();
            EXPECT_EQ(mFilter->RenderCallback(nullptr, nullptr, bus, frames, &pulled.Get()), noErr);
            EXPECT_EQ(row[0], expected[bus]) << bus;
        }
        data.mBuffers[0].mData = nullptr;
        return noErr;
    };
    Process(4);
}

TEST_F(XAUProcessingTest, OnlyTheFirstInputIsFedWithoutASideChain)
{
    mUnit.SetElements(kAudioUnitScope_Input, {2, 2});
    Start();
    const auto callbackOf = [&](UInt32 element)
    {
        return mUnit.Read<AURenderCallbackStruct>(
            {kAudioUnitProperty_SetRenderCallback, kAudioUnitScope_Input, element});
    };
    EXPECT_EQ(callbackOf(0).inputProcRefCon, mFilter.get());
    EXPECT_TRUE(mUnit.Has({kAudioUnitProperty_SetRenderCallback, kAudioUnitScope_Input, 1}));
    EXPECT_EQ(callbackOf(1).inputProc, nullptr);
    EXPECT_EQ(callbackOf(1).inputProcRefCon, nullptr);
    mFilter->SetSideChainTargetBus(
        AudioFilterBusDescription::CreateStereo(u"Side", AudioFilterBusDescription::kBusType_SideChain));
    mFilter->Resume();
    EXPECT_EQ(callbackOf(1).inputProc, &XAUAudioFilter::StaticRenderCallback);
}

class XAUHostCallbacksTest : public XAUProcessingTest
{
protected:
    void SetUp() override
    {
        Start();
        mFilter->SetSampleRate(48000.0F);
        mCallbacks = mUnit.Read<HostCallbackInfo>(Global(kAudioUnitProperty_HostCallbacks));
        ASSERT_TRUE(mCallbacks.beatAndTempoProc && mCallbacks.musicalTimeLocationProc &&
                    mCallbacks.transportStateProc);
        EXPECT_EQ(mCallbacks.transportStateProc2, nullptr);
    }
    void TearDown() override { mFilter->SetAudioFilterHost(nullptr); }

    Host mHost;
    HostCallbackInfo mCallbacks = {};
};

TEST_F(XAUHostCallbacksTest, TellTheHostsTempoAndPlace)
{
    double beat = -1.0;
    double tempo = -1.0;
    EXPECT_EQ(mCallbacks.beatAndTempoProc(mCallbacks.hostUserData, &beat, &tempo), 0);
    EXPECT_EQ(beat, -1.0) << "without a host nothing is told";
    EXPECT_EQ(tempo, -1.0);
    mFilter->SetAudioFilterHost(&mHost);
    mFilter->SetCurrentOffset(96000);
    EXPECT_EQ(mCallbacks.beatAndTempoProc(mCallbacks.hostUserData, &beat, &tempo), 0);
    EXPECT_EQ(beat, 4.0);
    EXPECT_EQ(tempo, 90.0);
    EXPECT_EQ(mCallbacks.beatAndTempoProc(mCallbacks.hostUserData, nullptr, nullptr), 0);
}

TEST_F(XAUHostCallbacksTest, TellTheSignature)
{
    UInt32 delta = 9;
    Float32 numerator = 9.0F;
    UInt32 denominator = 9;
    double downBeat = 9.0;
    const auto ask = [&]
    {
        return mCallbacks.musicalTimeLocationProc(mCallbacks.hostUserData, &delta, &numerator, &denominator,
                                                  &downBeat);
    };
    EXPECT_EQ(ask(), 0);
    EXPECT_EQ(numerator, 0.0F) << "zeros without a host";
    EXPECT_EQ(denominator, 0U);
    mFilter->SetAudioFilterHost(&mHost);
    EXPECT_EQ(ask(), 0);
    EXPECT_EQ(numerator, 3.0F);
    EXPECT_EQ(denominator, 8U);
    EXPECT_EQ(delta, 0U);
    EXPECT_EQ(downBeat, 0.0);
    EXPECT_EQ(mCallbacks.musicalTimeLocationProc(mCallbacks.hostUserData, nullptr, nullptr, nullptr, nullptr), 0);
}

TEST_F(XAUHostCallbacksTest, TellWhetherTheFilterRuns)
{
    Boolean playing = 9;
    Boolean changed = 9;
    Boolean cycling = 9;
    double sample = -1.0;
    double start = -1.0;
    double end = -1.0;
    const auto ask = [&]
    {
        return mCallbacks.transportStateProc(mCallbacks.hostUserData, &playing, &changed, &sample, &cycling, &start,
                                             &end);
    };
    mFilter->SetCurrentOffset(123);
    EXPECT_EQ(ask(), 0);
    EXPECT_EQ(playing, 1);
    EXPECT_EQ(changed, 1);
    EXPECT_EQ(sample, 123.0);
    EXPECT_EQ(cycling, 0);
    EXPECT_EQ(start, 0.0);
    EXPECT_EQ(end, 0.0);
    mFilter->Suspend();
    EXPECT_EQ(ask(), 0);
    EXPECT_EQ(playing, 0);
    EXPECT_EQ(
        mCallbacks.transportStateProc(mCallbacks.hostUserData, nullptr, nullptr, nullptr, nullptr, nullptr, nullptr),
        0);
}

} // namespace
} // namespace zebaudiofilterhost::xau
