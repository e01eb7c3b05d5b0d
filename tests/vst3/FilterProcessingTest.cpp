// What the process thread does in a VST 3 filter, and how changes are delivered while no audio runs.

#include "foundation/zebcore/Trace.h"
#include "tests/audiofilter/FloatingPointControl.h"
#include "tests/vst3/FakePlugin.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <stdexcept>
#include <string_view>

using namespace fakeplugin;
using testing::ElementsAre;
using zebaudiofilterhost::ChannelFlags;
using zebaudiofilterhost::IAudioFilterHost;

namespace
{

class FakeHost : public IAudioFilterHost
{
public:
    bool GetTimeInfo(zebaudiofilterhost::utility::TimecodeFormat&, int&, int&) const override { return false; }
    bool GetTempo(zebaudiofilterhost::utility::Tempo& result) const override
    {
        result = tempo;
        return hasTempo;
    }
    bool GetTransportState(bool& playing, bool& recording, bool& looping) const override
    {
        playing = transport[0];
        recording = transport[1];
        looping = transport[2];
        return hasTransport;
    }

    bool hasTempo = false;
    bool hasTransport = false;
    zebaudiofilterhost::utility::Tempo tempo;
    std::array<bool, 3> transport = {};
};

// One point of one queue, as "ID: offset=value ...".
std::string Describe(IParameterChanges& changes)
{
    std::string text;
    for (int32 index = 0; index < changes.getParameterCount(); ++index)
    {
        IParamValueQueue* queue = changes.getParameterData(index);
        text += std::to_string(queue->getParameterId()) + ":";
        for (int32 point = 0; point < queue->getPointCount(); ++point)
        {
            int32 offset = 0;
            double value = 0;
            queue->getPoint(point, offset, value);
            text += " " + std::to_string(offset) + "=" + std::to_string(value).substr(0, 4);
        }
        text += ";";
    }
    return text;
}

class FilterProcessing : public testing::Test
{
protected:
    void Start()
    {
        filter = plugin.MakeFilter();
        filter->SetSampleRate(48000.0F);
        filter->SetBlockSize(4096);
        filter->Resume();
        plugin.ClearCalls();
    }

    // Channel n of the input starts at n * 10000 and counts up, so that a pointer tells where it came from.
    ChannelFlags Process(int frames, unsigned long long inFlags = 0, unsigned long long outFlags = 0)
    {
        for (std::size_t channel = 0; channel < in.size(); ++channel)
            in[channel] = inSamples.data() + channel * 10000;
        for (std::size_t channel = 0; channel < out.size(); ++channel)
            out[channel] = outSamples.data() + channel * 10000;
        ChannelFlags flags(outFlags);
        filter->Process(in.data(), out.data(), frames, ChannelFlags(inFlags), flags);
        return flags;
    }

    void TearDown() override
    {
        if (!filter)
            return;
        filter->Suspend();
        while (filter->GetRefCount() > 1) // queued messages keep it alive
            filter->FlushMessageQueue();
    }

    FakePlugin plugin;
    boost::intrusive_ptr<zebaudiofilterhost::vst3::VST3AudioFilter> filter;
    std::array<float*, 8> in = {};
    std::array<float*, 8> out = {};
    std::vector<float> inSamples = std::vector<float>(80000);
    std::vector<float> outSamples = std::vector<float>(80000);
};

} // namespace

TEST_F(FilterProcessing, LongBlocksAreSliced)
{
    Start();
    std::vector<long long> positions;
    std::vector<std::ptrdiff_t> inOffsets;
    std::vector<std::ptrdiff_t> outOffsets;
    plugin.process = [&](ProcessData& data)
    {
        positions.push_back(data.processContext->projectTimeSamples);
        inOffsets.push_back(data.inputs[0].channelBuffers32[1] - inSamples.data());
        outOffsets.push_back(data.outputs[0].channelBuffers32[1] - outSamples.data());
        return kResultOk;
    };
    filter->SetCurrentOffset(500);
    Process(2500);
    EXPECT_THAT(plugin.Calls(), ElementsAre("processor.setProcessing 1", "processor.process 1024",
                                            "processor.process 1024", "processor.process 452"));
    EXPECT_THAT(positions, ElementsAre(500, 1524, 2548));
    EXPECT_THAT(inOffsets, ElementsAre(10000, 11024, 12048));
    EXPECT_EQ(outOffsets, inOffsets);
    Process(1);
    EXPECT_EQ(positions.back(), 3000);
    EXPECT_EQ(plugin.CallsTo("processor.setProcessing").size(), 1U);
    EXPECT_EQ(filter->GetMaxProcessingBlockSize(), 1024);
    plugin.ClearCalls();
    filter->Suspend();
    EXPECT_THAT(plugin.Calls(), ElementsAre("processor.setProcessing 0", "component.setActive 0"));
}

TEST_F(FilterProcessing, NoFramesMeansNoCall)
{
    Start();
    EXPECT_EQ(Process(0, 0, 0xff).Value(), 0U);
    EXPECT_TRUE(plugin.Calls().empty());
}

TEST_F(FilterProcessing, EveryBusHasItsChannels)
{
    plugin.inputs = {{SpeakerArr::kStereo}, {SpeakerArr::kMono, u"Key", kAux}, {SpeakerArr::k51}};
    plugin.outputs = {{SpeakerArr::kMono}, {SpeakerArr::kStereo}};
    Start();
    std::vector<std::ptrdiff_t> channels;
    plugin.process = [&](ProcessData& data)
    {
        const auto add = [&](AudioBusBuffers* buses, int32 count, const float* base)
        {
            for (int32 bus = 0; bus < count; ++bus)
            {
                channels.push_back(-buses[bus].numChannels);
                for (int32 channel = 0; channel < std::min(buses[bus].numChannels, 3); ++channel)
                    channels.push_back((buses[bus].channelBuffers32[channel] - base) / 10000);
            }
        };
        add(data.inputs, data.numInputs, inSamples.data());
        add(data.outputs, data.numOutputs, outSamples.data());
        EXPECT_EQ(data.processMode, kRealtime);
        EXPECT_EQ(data.symbolicSampleSize, kSample32);
        return kResultOk;
    };
    in.back() = nullptr;
    std::array<float*, 9> nine = {};
    for (std::size_t channel = 0; channel < nine.size(); ++channel)
        nine[channel] = inSamples.data() + (channel % 8) * 10000;
    for (std::size_t channel = 0; channel < out.size(); ++channel)
        out[channel] = outSamples.data() + channel * 10000;
    ChannelFlags flags;
    filter->Process(nine.data(), out.data(), 16, ChannelFlags(), flags);
    EXPECT_THAT(channels, ElementsAre(-2, 0, 1, -1, 2, -6, 3, 4, 5, -1, 0, -2, 1, 2));
}

TEST_F(FilterProcessing, InputSilenceStandsAtAbsoluteChannels)
{
    plugin.inputs = {{SpeakerArr::kStereo}, {SpeakerArr::kStereo}};
    Start();
    std::vector<uint64> flags;
    plugin.process = [&](ProcessData& data)
    {
        flags = {data.inputs[0].silenceFlags, data.inputs[1].silenceFlags, data.outputs[0].silenceFlags};
        data.outputs[0].silenceFlags = 3;
        return kResultOk;
    };
    Process(16, 0b1000);
    EXPECT_THAT(flags, ElementsAre(0U, 0b1000U, 0U));
    Process(16, 0b0110);
    EXPECT_THAT(flags, ElementsAre(0b10U, 0b100U, 0U));
}

TEST_F(FilterProcessing, OutputSilenceIsShiftedByTheChannelsBefore)
{
    plugin.outputs = {{SpeakerArr::kStereo}, {SpeakerArr::kStereo}};
    Start();
    plugin.process = [](ProcessData& data)
    {
        data.outputs[1].silenceFlags = 0b10;
        return kResultOk;
    };
    EXPECT_EQ(Process(16, 0, 0xff).Value(), 0b1000U);
}

TEST_F(FilterProcessing, ChannelsBeyond64ShareBits)
{
    plugin.outputs.assign(33, {SpeakerArr::kStereo});
    plugin.inputs.assign(33, {SpeakerArr::kStereo});
    Start();
    std::vector<float*> channels(66, inSamples.data());
    uint64 last = 0;
    plugin.process = [&](ProcessData& data)
    {
        last = data.inputs[32].silenceFlags;
        data.outputs[32].silenceFlags = 0b11;
        return kResultOk;
    };
    ChannelFlags flags;
    filter->Process(channels.data(), channels.data(), 16, ChannelFlags(0b10), flags);
    EXPECT_EQ(last, 0b10U);
    EXPECT_EQ(flags.Value(), 0b11U);
}

TEST_F(FilterProcessing, FailureIsTracedOncePerResume)
{
    Start();
    plugin.process = [](ProcessData&)
    {
        return kInternalError;
    };
    std::string lines;
    zebcore::debug::SetTraceSink([&](std::string_view line) { lines += line.substr(line.find("> <6> ") + 6); });
    zebcore::debug::SetTraceCategoryEnabled("VST3AudioFilter::Process", true);
    Process(3000);
    Process(10);
    EXPECT_EQ(plugin.CallsTo("processor.process").size(), 4U);
    EXPECT_EQ(lines, "failed with result: 4\n");
    filter->Suspend();
    filter->Resume();
    Process(10);
    zebcore::debug::SetTraceCategoryEnabled("VST3AudioFilter::Process", false);
    zebcore::debug::SetTraceSink({});
    EXPECT_EQ(lines, "failed with result: 4\nfailed with result: 4\n");
}

TEST_F(FilterProcessing, ChangesGoToTheFirstSliceAndFold)
{
    plugin.parameters = {{7}, {9}};
    Start();
    std::vector<std::string> changes;
    plugin.process = [&](ProcessData& data)
    {
        changes.push_back(Describe(*data.inputParameterChanges));
        return kResultOk;
    };
    filter->SetParameter(1, 0.25F);
    filter->SetParameter(1, 0.5F);
    filter->performEdit(7, 0.75);
    Process(1500);
    EXPECT_THAT(changes, ElementsAre("7: 0=0.75;9: 0=0.50;", ""));
    EXPECT_THAT(plugin.CallsTo("controller"),
                ElementsAre("controller.setParamNormalized 9 0.25", "controller.setParamNormalized 9 0.5"));
}

TEST_F(FilterProcessing, WhatTheProcessorWritesReachesTheControllerAtTheTick)
{
    plugin.parameters = {{7}, {8, ParameterInfo::kIsReadOnly}};
    Start();
    int signals = 0;
    filter->ConnectAutomatedParameterChange([&](int, float) { ++signals; });
    plugin.process = [&](ProcessData& data)
    {
        int32 index = 0;
        data.outputParameterChanges->addParameterData(8, index)->addPoint(3, 0.5, index);
        data.outputParameterChanges->addParameterData(7, index)->addPoint(0, 0.25, index);
        data.outputParameterChanges->addParameterData(1234, index)->addPoint(0, 1.0, index);
        return kResultOk;
    };
    Process(10);
    EXPECT_TRUE(plugin.CallsTo("controller").empty());
    filter->OnUITimerTick();
    EXPECT_THAT(plugin.CallsTo("controller"),
                ElementsAre("controller.setParamNormalized 7 0.25", "controller.setParamNormalized 8 0.5"));
    EXPECT_EQ(signals, 0);
}

TEST_F(FilterProcessing, EventsAreDroppedAfterEachSlice)
{
    plugin.eventInputs = 1;
    plugin.eventOutputs = 1;
    Start();
    std::vector<int32> counts;
    plugin.process = [&](ProcessData& data)
    {
        counts.push_back(data.outputEvents->getEventCount() + data.inputEvents->getEventCount());
        Event event = {};
        data.outputEvents->addEvent(event);
        return kResultOk;
    };
    Process(2000);
    EXPECT_THAT(counts, ElementsAre(0, 0));
}

TEST_F(FilterProcessing, WhatThePluginThrowsEndsTheBlockOnly)
{
    plugin.parameters = {{7}};
    Start();
    std::vector<std::string> changes;
    bool throws = true;
    plugin.process = [&](ProcessData& data)
    {
        changes.push_back(Describe(*data.inputParameterChanges));
        if (throws)
            throw std::runtime_error("process");
        return kResultOk;
    };
    filter->SetParameter(0, 0.5F);
    EXPECT_EQ(Process(2000, 0, 0xf0).Value(), 0U);
    throws = false;
    Process(10);
    EXPECT_THAT(changes, ElementsAre("7: 0=0.50;", ""));
}

TEST_F(FilterProcessing, ContextWithoutHostKnowsPlayingOnly)
{
    Start();
    ProcessContext context = {};
    plugin.process = [&](ProcessData& data)
    {
        context = *data.processContext;
        return kResultOk;
    };
    Process(1);
    EXPECT_EQ(context.state, static_cast<uint32>(ProcessContext::kPlaying));
    EXPECT_EQ(context.sampleRate, 48000.0);
    EXPECT_EQ(context.systemTime, 0);
}

TEST_F(FilterProcessing, ContextTakesTempoAndTransportFromTheHost)
{
    Start();
    FakeHost host;
    filter->SetAudioFilterHost(&host);
    ProcessContext context = {};
    plugin.process = [&](ProcessData& data)
    {
        context = *data.processContext;
        return kResultOk;
    };
    Process(1);
    EXPECT_EQ(context.state, static_cast<uint32>(ProcessContext::kSystemTimeValid));
    EXPECT_NE(context.systemTime, 0);

    host.hasTempo = true;
    host.hasTransport = true;
    host.transport = {true, false, true};
    host.tempo.mTempo = 90.0;
    host.tempo.mNumerator = 3;
    host.tempo.mDenominator = 8;
    filter->SetCurrentOffset(96000);
    Process(1);
    EXPECT_EQ(context.state,
              static_cast<uint32>(ProcessContext::kSystemTimeValid | ProcessContext::kProjectTimeMusicValid |
                                  ProcessContext::kTempoValid | ProcessContext::kBarPositionValid |
                                  ProcessContext::kTimeSigValid | ProcessContext::kPlaying |
                                  ProcessContext::kCycleActive));
    EXPECT_EQ(context.tempo, 90.0);
    EXPECT_EQ(context.timeSigNumerator, 3);
    EXPECT_EQ(context.timeSigDenominator, 8);
    EXPECT_DOUBLE_EQ(context.projectTimeMusic, 4.0); // 2 s at 90 beats a minute, the first beat being 1
    EXPECT_DOUBLE_EQ(context.barPositionMusic, 4.0);
    filter->SetAudioFilterHost(nullptr);
}

// Two of the positions that single precision cannot hold: the musical time is coarser than the bar position.
TEST_F(FilterProcessing, ProjectTimeIsComputedInSinglePrecision)
{
    Start();
    FakeHost host;
    host.hasTempo = true;
    host.tempo.mTempo = 120.0;
    filter->SetAudioFilterHost(&host);
    ProcessContext context = {};
    plugin.process = [&](ProcessData& data)
    {
        context = *data.processContext;
        return kResultOk;
    };
    filter->SetCurrentOffset(16777217);
    Process(1);
    EXPECT_EQ(context.projectTimeMusic, static_cast<double>(16777216.0F / 48000.0F) * 120.0 / 60.0 + 1.0);
    EXPECT_EQ(context.barPositionMusic, 16777217.0 / (2880000.0 / 120.0) + 1.0);
    filter->SetAudioFilterHost(nullptr);
}

TEST_F(FilterProcessing, SlicesShareTheMusicalTime)
{
    Start();
    FakeHost host;
    host.hasTempo = true;
    host.tempo.mTempo = 120.0;
    filter->SetAudioFilterHost(&host);
    std::vector<double> music;
    plugin.process = [&](ProcessData& data)
    {
        music.push_back(data.processContext->projectTimeMusic);
        return kResultOk;
    };
    Process(2048);
    EXPECT_THAT(music, ElementsAre(1.0, 1.0));
    filter->SetAudioFilterHost(nullptr);
}

TEST_F(FilterProcessing, SuspendedFilterFlushesWithoutSamples)
{
    plugin.parameters = {{7}};
    filter = plugin.MakeFilter();
    std::vector<std::string> changes;
    plugin.process = [&](ProcessData& data)
    {
        changes.push_back(Describe(*data.inputParameterChanges));
        EXPECT_EQ(data.numSamples, 0);
        EXPECT_EQ(data.numInputs + data.numOutputs, 0);
        EXPECT_EQ(data.inputs, nullptr);
        EXPECT_EQ(data.outputs, nullptr);
        return kResultOk;
    };
    plugin.ClearCalls();
    filter->FlushMessageQueue();
    EXPECT_TRUE(plugin.CallsTo("processor").empty());
    filter->SetParameter(0, 0.5F);
    filter->FlushMessageQueue();
    filter->FlushMessageQueue();
    EXPECT_THAT(changes, ElementsAre("7: 0=0.50;"));
    EXPECT_THAT(plugin.CallsTo("processor"), ElementsAre("processor.process 0"));
}

TEST_F(FilterProcessing, AFlushLeavesTheMainThreadItsFloatingPointMode)
{
    using namespace zebaudiofilterhost::testing;
    const FloatingPointRestorer restorer;
    const auto mode = GetFloatingPointMode();
    plugin.parameters = {{7}};
    Start();
    filter->Suspend();
    for (const bool throws : {false, true})
    {
        bool isCalled = false;
        plugin.process = [&](ProcessData&)
        {
            isCalled = true;
            SetFloatingPointWord(GetFloatingPointWord() ^ kFlushAndRoundDown);
            if (throws)
                throw 1;
            return kResultOk;
        };
        filter->SetParameter(0, 0.5F);
        filter->FlushMessageQueue();
        EXPECT_TRUE(isCalled);
        EXPECT_EQ(GetFloatingPointMode(), mode) << throws;
    }
}

TEST_F(FilterProcessing, ThrowingFlushKeepsTheBusesAndForgetsTheChanges)
{
    plugin.parameters = {{7}};
    Start();
    filter->SetParameter(0, 0.5F);
    std::vector<std::string> calls;
    bool throws = true;
    plugin.process = [&](ProcessData& data)
    {
        calls.push_back(std::to_string(data.numInputs) + "/" + Describe(*data.inputParameterChanges));
        if (throws)
            throw 1;
        return kResultOk;
    };
    filter->Suspend();
    filter->FlushMessageQueue();
    throws = false;
    filter->FlushMessageQueue();
    filter->Resume();
    Process(10);
    EXPECT_THAT(calls, ElementsAre("0/7: 0=0.50;", "1/"));
}

// The flush between the two steps of Resume: buses are there again afterwards.
TEST_F(FilterProcessing, PendingChangesAreDeliveredByResumeItself)
{
    plugin.parameters = {{7}};
    filter = plugin.MakeFilter();
    filter->SetBlockSize(64);
    filter->SetParameter(0, 0.5F);
    std::vector<std::string> calls;
    plugin.process = [&](ProcessData& data)
    {
        calls.push_back(std::to_string(data.numInputs) + "/" + Describe(*data.inputParameterChanges));
        return kResultOk;
    };
    filter->Resume();
    Process(10);
    EXPECT_THAT(calls, ElementsAre("0/7: 0=0.50;", "1/"));
}

TEST_F(FilterProcessing, RunningFilterDoesNotFlush)
{
    plugin.parameters = {{7}};
    Start();
    filter->SetParameter(0, 0.5F);
    plugin.ClearCalls();
    filter->FlushMessageQueue();
    EXPECT_TRUE(plugin.CallsTo("processor").empty());
}

// New buses come with new event lists: a flush before the next Resume must not reach the old ones.
TEST_F(FilterProcessing, FlushAfterNewBusesSeesNoOldEventLists)
{
    plugin.parameters = {{7}};
    plugin.eventInputs = 1;
    Start();
    filter->Suspend();
    const auto mono = zebmediatypes::CreateMonoChannelLayout();
    filter->RequestIOConfiguration({mono}, {mono});
    filter->SetParameter(0, 0.5F);
    bool called = false;
    plugin.process = [&](ProcessData& data)
    {
        called = true;
        EXPECT_EQ(data.inputEvents, nullptr);
        return kResultOk;
    };
    filter->FlushMessageQueue();
    EXPECT_TRUE(called);
}

TEST_F(FilterProcessing, PostedParametersReachTheBlockThatFollows)
{
    plugin.parameters = {{7}};
    Start();
    std::string changes;
    plugin.process = [&](ProcessData& data)
    {
        changes += Describe(*data.inputParameterChanges);
        return kResultOk;
    };
    filter->PostSetParameter(0, 0.5F);
    float sample[16] = {};
    float* channels[] = {sample, sample};
    ChannelFlags flags;
    filter->ProcessWithMapping(channels, channels, 16, ChannelFlags(), flags);
    EXPECT_EQ(changes, "7: 0=0.50;");
}
