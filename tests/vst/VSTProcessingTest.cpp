// Audio through a VST 2 filter: pins, blocks, and plug-ins that lie or throw.

#include "tests/vst/support/FakeFilter.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <limits>
#include <numeric>
#include <stdexcept>

using namespace fakeeffect;
using testing::Each;
using testing::ElementsAre;

namespace
{

constexpr float kOld = 9.0F; // what the caller left in its outputs

// The application's side: inputs that differ by channel and frame, outputs with a guard behind the block.
struct Buffers
{
    Buffers(int inputs, int outputs, int frames)
        : in(static_cast<std::size_t>(inputs), std::vector<float>(static_cast<std::size_t>(frames)))
        , out(static_cast<std::size_t>(outputs), std::vector<float>(static_cast<std::size_t>(frames) + 1, kOld))
    {
        float start = 1.0F;
        for (std::vector<float>& channel : in)
        {
            std::iota(channel.begin(), channel.end(), start);
            start += 10000.0F;
            inPointers.push_back(channel.data());
        }
        for (std::vector<float>& channel : out)
            outPointers.push_back(channel.data());
    }

    // An output without its guard.
    std::vector<float> Output(std::size_t channel) const
    {
        EXPECT_EQ(out[channel].back(), kOld) << "written behind the block";
        return {out[channel].begin(), out[channel].end() - 1};
    }

    std::vector<std::vector<float>> in;
    std::vector<std::vector<float>> out;
    std::vector<float*> inPointers;
    std::vector<float*> outPointers;
};

class Processing : public FilterTest
{
protected:
    ChannelFlags Process(Buffers& buffers)
    {
        ChannelFlags flags(~0ULL);
        const auto frames = static_cast<int>(buffers.out.empty() ? buffers.in[0].size() : buffers.out[0].size() - 1);
        filter->Process(buffers.inPointers.data(), buffers.outPointers.data(), frames, ChannelFlags(), flags);
        return flags;
    }

    void RequestMono() { filter->RequestIOConfiguration({ChannelLayout(1)}, {ChannelLayout(1)}); }
};

} // namespace

TEST_F(Processing, GivesThePlugInTheBlock)
{
    MakeRunning();
    Buffers buffers(2, 2, 64);
    EXPECT_EQ(Process(buffers).Value(), 0U) << "no output is silent";
    EXPECT_EQ(buffers.Output(0), buffers.in[0]);
    EXPECT_EQ(buffers.Output(1), buffers.in[1]);
    EXPECT_EQ(fake.CallsTo("processReplacing").at(0).value, 64);
    EXPECT_EQ(fake.Count("process"), 0U);
}

// As many frames as there are channels, and no more than the block has.
TEST_F(Processing, ClearsAFewFramesForAPlugInThatAdds)
{
    struct
    {
        int channels;
        int frames;
        int cleared;
    } const rows[] = {{1, 8, 1}, {2, 8, 2}, {2, 1, 1}, {6, 8, 6}, {6, 4, 4}, {4, 0, 0}};
    for (const auto& row : rows)
    {
        fake.effect.flags = 0;
        fake.effect.numInputs = fake.effect.numOutputs = row.channels;
        MakeRunning();
        Buffers buffers(row.channels, row.channels, row.frames);
        Process(buffers);
        for (std::size_t channel = 0; channel < buffers.in.size(); ++channel)
        {
            std::vector<float> expected = buffers.in[channel];
            std::for_each(expected.begin() + row.cleared, expected.end(), [](float& frame) { frame += kOld; });
            EXPECT_EQ(buffers.Output(channel), expected) << row.channels << " channels, " << row.frames << " frames";
        }
    }
    EXPECT_EQ(fake.Count("processReplacing"), 0U);
}

TEST_F(Processing, FeedsMonoThroughTwoPins)
{
    for (const int flags : {static_cast<int>(effFlagsCanReplacing), 0})
    {
        fake.effect.flags = effFlagsCanMono | flags;
        Make();
        filter->SetBlockSize(32);
        RequestMono();
        ASSERT_EQ(filter->GetNumberOfInputChannels(), 1);
        filter->Resume();
        Buffers buffers(1, 1, 32);
        fake.replace = fake.accumulate = [&](float** inputs, float** outputs, int frames)
        {
            EXPECT_EQ(frames, 32);
            EXPECT_EQ(inputs[0], buffers.inPointers[0]);
            EXPECT_EQ(inputs[1], buffers.inPointers[0]);
            EXPECT_EQ(outputs[0], buffers.outPointers[0]);
            EXPECT_NE(outputs[1], buffers.outPointers[0]);
            std::copy_n(inputs[0], frames, outputs[0]);
            std::fill_n(outputs[1], frames, 5.0F);
        };
        Process(buffers);
        EXPECT_EQ(buffers.Output(0), buffers.in[0]);
    }
    EXPECT_EQ(fake.Count("process"), 1U);
    EXPECT_EQ(fake.Count("processReplacing"), 1U);
}

// Two frames are cleared, although the bus has one channel.
TEST_F(Processing, ClearsForBothPinsOfMonoThroughStereo)
{
    fake.effect.flags = effFlagsCanMono;
    Make();
    filter->SetBlockSize(4);
    RequestMono();
    filter->Resume();
    Buffers buffers(1, 1, 4);
    float second = -1.0F;
    fake.accumulate = [&](float**, float** outputs, int)
    {
        second = outputs[1][0] + outputs[1][1];
        outputs[1][0] = outputs[1][1] = outputs[1][2] = 3.0F;
    };
    Process(buffers);
    EXPECT_THAT(buffers.Output(0), ElementsAre(0.0F, 0.0F, kOld, kOld));
    Process(buffers);
    EXPECT_EQ(second, 0.0F);
}

// Whatever the plug-in says of its pins and the buses of their channels.
TEST_F(Processing, EachPinHasABuffer)
{
    struct
    {
        int pinsIn;
        int pinsOut;
        int busIn;
        int busOut;
    } const rows[] = {{2, 2, 1, 1}, {6, 6, 2, 2}, {100, 50, 2, 1}, {0, 2, 0, 2}, {2, 0, 2, 0}, {1, 1, 6, 6}};
    for (const auto& row : rows)
    {
        Make();
        filter->ClearBusConfiguration();
        filter->AddInputBus(
            {u"In", ChannelLayout(static_cast<std::size_t>(row.busIn)), AudioFilterBusDescription::kBusType_Main});
        filter->AddOutputBus(
            {u"Out", ChannelLayout(static_cast<std::size_t>(row.busOut)), AudioFilterBusDescription::kBusType_Main});
        fake.effect.numInputs = row.pinsIn;
        fake.effect.numOutputs = row.pinsOut;
        filter->SetBlockSize(16);
        filter->Resume();
        Buffers buffers(row.busIn, row.busOut, 16);
        fake.replace = [&](float** inputs, float** outputs, int frames)
        {
            for (int pin = row.busIn; pin < row.pinsIn; ++pin)
                EXPECT_THAT(std::vector<float>(inputs[pin], inputs[pin] + frames), Each(0.0F)) << pin;
            for (int pin = row.busIn; pin < row.pinsIn; ++pin)
                std::fill_n(inputs[pin], frames, 1.0F); // which plug-ins must not do, and some do
            for (int pin = 0; pin < row.pinsOut; ++pin)
                std::fill_n(outputs[pin], frames, 2.0F);
        };
        for (int block = 0; block < 3; ++block)
            Process(buffers);
        for (std::size_t channel = 0; channel < buffers.out.size(); ++channel)
            EXPECT_THAT(buffers.Output(channel), Each(channel < static_cast<std::size_t>(row.pinsOut) ? 2.0F : kOld));
    }
}

TEST_F(Processing, PinsMayAppearWhileThePlugInIsSwitchedOn)
{
    for (const int pins : {3, 32, 128, 4096})
    {
        fake.On(effMainsChanged,
                [this, pins](int, long long value, void*, float)
                {
                    fake.effect.numInputs = fake.effect.numOutputs = value != 0 ? pins : 2;
                    return 0LL;
                });
        fake.effect.numInputs = fake.effect.numOutputs = 2;
        MakeRunning(16);
        fake.replace = [pins](float** inputs, float** outputs, int frames)
        {
            for (int pin = 2; pin < pins; ++pin)
                ASSERT_THAT(std::vector<float>(inputs[pin], inputs[pin] + frames), Each(0.0F)) << pin;
            for (int pin = 0; pin < pins; ++pin)
                std::copy_n(inputs[pin], frames, outputs[pin]);
            std::fill_n(inputs[2], frames, 1.0F); // which plug-ins must not do, and some do
        };
        for (int block = 0; block < 2; ++block)
        {
            Buffers buffers(2, 2, 16);
            Process(buffers);
            EXPECT_EQ(buffers.Output(1), buffers.in[1]) << pins;
        }
    }
}

TEST_F(Processing, PinsMayAppearWhileThePlugInRuns)
{
    MakeRunning(16);
    Buffers buffers(2, 2, 16);
    Process(buffers);
    fake.effect.numInputs = fake.effect.numOutputs = 128;
    fake.replace = [](float** inputs, float** outputs, int frames)
    {
        EXPECT_THAT(std::vector<float>(inputs[127], inputs[127] + frames), Each(0.0F));
        std::fill_n(inputs[127], frames, 1.0F);
        std::fill_n(outputs[127], frames, 1.0F);
        std::fill_n(outputs[1], frames, 2.0F);
    };
    for (int block = 0; block < 2; ++block)
    {
        Process(buffers);
        EXPECT_THAT(buffers.Output(1), Each(2.0F));
    }
}

TEST_F(Processing, AbsurdCountsAreNotBelieved)
{
    for (const int count : {-1, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()})
    {
        fake.effect.numInputs = fake.effect.numOutputs = count;
        MakeRunning();
        fake.replace = [](float** inputs, float** outputs, int frames)
        {
            std::copy_n(inputs[0], frames, outputs[0]);
        };
        Buffers buffers(filter->GetNumberOfInputChannels(), filter->GetNumberOfOutputChannels(), 64);
        buffers.in.resize(1, std::vector<float>(64)); // for the length
        Process(buffers);
    }
    EXPECT_EQ(fake.Count("processReplacing"), 3U);
}

// No application may do this; our own buffers hold all the same.
TEST_F(Processing, LongerBlocksThanToldComeThrough)
{
    fake.effect.flags |= effFlagsCanMono;
    Make();
    filter->SetBlockSize(64);
    RequestMono();
    filter->Resume();
    for (const int frames : {65, 2048, 2049, 10000})
    {
        Buffers buffers(1, 1, frames);
        Process(buffers);
        EXPECT_EQ(buffers.Output(0), buffers.in[0]);
    }
    fake.effect.flags = 0;
    MakeRunning();
    Buffers buffers(2, 2, 5000);
    Process(buffers);
    EXPECT_EQ(buffers.Output(1)[1], buffers.in[1][1]);
    EXPECT_EQ(buffers.Output(1)[2], buffers.in[1][2] + kOld);
    EXPECT_EQ(buffers.Output(1)[4999], buffers.in[1][4999] + kOld);
}

TEST_F(Processing, WorksBeforeResume)
{
    Make();
    Buffers buffers(2, 2, 300);
    Process(buffers);
    EXPECT_EQ(buffers.Output(1), buffers.in[1]);
    EXPECT_EQ(fake.CallsTo("processReplacing").at(0).value, 300);
}

// A request that is none ends mono through stereo, and leaves mono buses before two pins.
TEST_F(Processing, ForgetsTheMonoInputWithItsConfiguration)
{
    fake.effect.flags |= effFlagsCanMono;
    Make();
    RequestMono();
    filter->Resume();
    Buffers first(1, 1, 16);
    Process(first);
    filter->Suspend();
    filter->RequestIOConfiguration({}, {});
    filter->Resume();
    Buffers second(1, 1, 16);
    fake.replace = [&](float** inputs, float** outputs, int)
    {
        EXPECT_EQ(inputs[0], second.inPointers[0]);
        EXPECT_NE(inputs[1], first.inPointers[0]);
        EXPECT_EQ(inputs[1][0], 0.0F);
        EXPECT_EQ(outputs[0], second.outPointers[0]);
    };
    Process(second);
}

TEST_F(Processing, WhatThePlugInThrowsEndsTheBlock)
{
    MakeRunning();
    fake.replace = [](float**, float** outputs, int)
    {
        outputs[0][0] = 1.0F;
        throw std::runtime_error("in process");
    };
    Buffers buffers(2, 2, 8);
    EXPECT_EQ(Process(buffers).Value(), 0U);
    EXPECT_EQ(buffers.Output(0)[0], 1.0F);
    fake.replace = {};
    Process(buffers);
    EXPECT_EQ(buffers.Output(0), buffers.in[0]);
}

TEST_F(Processing, AMissingFunctionIsNotCalled)
{
    for (const int flags : {0, static_cast<int>(effFlagsCanReplacing)})
    {
        fake.effect.flags = flags;
        fake.effect.process = nullptr;
        fake.effect.processReplacing = nullptr;
        MakeRunning();
        Buffers buffers(2, 2, 8);
        Process(buffers);
        EXPECT_EQ(buffers.Output(0)[7], kOld);
    }
}

// The application's four channels, of which two are the plug-in's.
TEST_F(Processing, RunsParametersAheadOfTheBlockInMappedRendering)
{
    fake.effect.numParams = 1;
    fake.parameters = {0.0F};
    fake.effect.initialDelay = -5;
    Make();
    filter->SetBlockSize(8);
    filter->SetChannelMapTargetChannelLayout(ChannelLayout(4));
    filter->SetUseChannelMap(true);
    filter->SetDefaultChannelMap(zebaudiofilterhost::AudioFilter::kDirection_Input);
    filter->SetDefaultChannelMap(zebaudiofilterhost::AudioFilter::kDirection_Output);
    filter->Resume();
    filter->PostSetParameter(0, 0.5F);
    float atProcess = 0.0F;
    fake.replace = [&](float** inputs, float** outputs, int frames)
    {
        atProcess = fake.parameters[0];
        std::copy_n(inputs[0], frames, outputs[1]);
        std::copy_n(inputs[1], frames, outputs[0]);
    };
    Buffers buffers(4, 4, 8);
    ChannelFlags silent;
    filter->ProcessWithMapping(buffers.inPointers.data(), buffers.outPointers.data(), 8, ChannelFlags(), silent);
    EXPECT_EQ(atProcess, 0.5F);
    EXPECT_EQ(buffers.Output(0), buffers.in[1]);
    EXPECT_EQ(buffers.Output(1), buffers.in[0]);
    EXPECT_EQ(buffers.Output(3), buffers.in[3]) << "what passes by is not delayed by a latency that is none";
    filter->Suspend();
}
