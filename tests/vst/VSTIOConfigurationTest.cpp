// Buses of a VST 2 filter: what it asks the plug-in for, and what it makes of the answer.

#include "foundation/zebcore/Trace.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "tests/vst/support/FakeEffect.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gtest/gtest.h>

#include <bit>
#include <climits>
#include <cstdlib>
#include <string>

namespace zebaudiofilterhost::vst
{

namespace
{

using fakeeffect::FakeEffect;

// "name(channels)" of each bus of the inputs, a bar, and those of the outputs.
std::string Buses(const AudioFilter& filter)
{
    std::string text;
    for (const auto* buses : {&filter.GetInputBuses(), &filter.GetOutputBuses()})
    {
        text += buses == &filter.GetInputBuses() ? "" : "|";
        for (const AudioFilterBusDescription& bus : *buses)
        {
            EXPECT_EQ(bus.GetType(), AudioFilterBusDescription::kBusType_Main);
            const UTF16String name = bus.GetName();
            text += std::string(name.begin(), name.end()) + "(" + std::to_string(bus.GetChannelCount()) + ")";
        }
    }
    return text;
}

// A plug-in that negotiates.
class IOConfiguration : public testing::Test
{
protected:
    void Make(int inputs, int outputs, int flags = effFlagsCanReplacing)
    {
        filter.reset();
        fake.effect.numInputs = inputs;
        fake.effect.numOutputs = outputs;
        fake.effect.flags = flags;
        filter = new VSTAudioFilter(u"2:1 Fake", u"/fake.so", fake.Get(), true, true);
    }

    void Request(std::size_t inputs, std::size_t outputs)
    {
        filter->RequestIOConfiguration({ChannelLayout(inputs)}, {ChannelLayout(outputs)});
    }

    // Accepts, and keeps what it is offered as far as the record is declared.
    void Accept()
    {
        fake.On(effSetSpeakerArrangement,
                [this](int, long long value, void* ptr, float)
                {
                    input = *std::bit_cast<const VstSpeakerArrangement*>(value);
                    output = *static_cast<const VstSpeakerArrangement*>(ptr);
                    return 1LL;
                });
        Answer(&input, &output);
    }

    void Answer(VstSpeakerArrangement* in, VstSpeakerArrangement* out, long long result = 1)
    {
        fake.On(effGetSpeakerArrangement,
                [in, out, result](int, long long value, void* ptr, float)
                {
                    *std::bit_cast<VstSpeakerArrangement**>(value) = in;
                    *static_cast<VstSpeakerArrangement**>(ptr) = out;
                    return result;
                });
    }

    FakeEffect fake;
    VstSpeakerArrangement input = {};
    VstSpeakerArrangement output = {};
    boost::intrusive_ptr<VSTAudioFilter> filter; // after all that the plug-in needs
};

} // namespace

TEST_F(IOConfiguration, CountsDecideAtFirst)
{
    struct Case
    {
        int inputs;
        int outputs;
        const char* buses;
    };
    for (const Case& expected :
         {Case{1, 1, "Mono In(1)|Mono Out(1)"}, Case{2, 2, "Stereo In(2)|Stereo Out(2)"},
          Case{6, 6, "Surround 5.1 In(6)|Surround 5.1 Out(6)"}, Case{0, 2, "Multi-Mono In(0)|Stereo Out(2)"},
          Case{8, 4, "Multi-Mono In(8)|Multi-Mono In(4)"}, Case{2, 0, "Stereo In(2)|Multi-Mono In(0)"},
          Case{-3, -1, "Multi-Mono In(0)|Multi-Mono In(0)"}})
    {
        Make(expected.inputs, expected.outputs);
        EXPECT_EQ(Buses(*filter), expected.buses);
    }
    EXPECT_EQ(fake.Count("effSetSpeakerArrangement"), 0U);
    Make(INT_MAX, INT_MAX); // no memory for so many
    EXPECT_EQ(filter->GetInputBuses().size(), 1U);
    EXPECT_LT(filter->GetNumberOfInputChannels(), 10000);
}

TEST_F(IOConfiguration, LayoutsOfTheCountsAreTheUsualOnes)
{
    Make(6, 2);
    EXPECT_TRUE(filter->GetInputBuses()[0].GetLayout() == zebmediatypes::CreateBroadcast51ChannelLayout());
    EXPECT_TRUE(filter->GetOutputBuses()[0].GetLayout() == zebmediatypes::CreateStereoChannelLayout());
    Make(1, 3);
    EXPECT_TRUE(filter->GetInputBuses()[0].GetLayout() == zebmediatypes::CreateMonoChannelLayout());
    EXPECT_TRUE(filter->GetOutputBuses()[0].GetLayout() == ChannelLayout(3));
}

TEST_F(IOConfiguration, AcceptedRequestsBecomeBuses)
{
    struct Case
    {
        std::size_t inputs;
        std::size_t outputs;
        const char* buses;
    };
    Make(2, 2);
    Accept();
    for (const Case& expected :
         {Case{1, 1, "Mono In(1)|Mono Out(1)"}, Case{2, 2, "Stereo In(2)|Stereo Out(2)"},
          Case{6, 6, "Surround 5.1 In(6)|Surround 5.1 Out(6)"}, Case{4, 4, "Multi-Mono In(4)|Multi-Mono Out(4)"},
          Case{8, 2, "Multi-Mono In(8)|Stereo Out(2)"}, Case{1, 5, "Mono In(1)|Multi-Mono Out(5)"},
          Case{20, 64, "Multi-Mono In(20)|Multi-Mono Out(64)"}})
    {
        Request(expected.inputs, expected.outputs);
        EXPECT_EQ(Buses(*filter), expected.buses);
    }
}

TEST_F(IOConfiguration, ThePluginsWordCountsAndNotTheRequest)
{
    struct Case
    {
        VstSpeakerArrangement input;
        VstSpeakerArrangement output;
        const char* buses;
    };
    Make(2, 2);
    fake.Return(effSetSpeakerArrangement, 1);
    for (const Case& expected :
         {Case{{kSpeakerArr51, 6, {}}, {kSpeakerArrStereo, 2, {}}, "Surround 5.1 In(6)|Stereo Out(2)"},
          Case{{kSpeakerArrMono, 3, {}}, {kSpeakerArrMono, 5, {}}, "Multi-Mono In(3)|Multi-Mono Out(5)"},
          Case{{kSpeakerArr71Cine, 8, {}}, {kSpeakerArrUserDefined, 1, {}}, "Multi-Mono In(8)|Multi-Mono Out(1)"},
          Case{{kSpeakerArrStereo, 1, {}}, {kSpeakerArr51, 64, {}}, "Stereo In(2)|Surround 5.1 Out(6)"}})
    {
        input = expected.input;
        output = expected.output;
        Answer(&input, &output);
        Request(2, 2);
        EXPECT_EQ(Buses(*filter), expected.buses);
    }
}

TEST_F(IOConfiguration, WhateverFailsEndsWithTheCounts)
{
    VstSpeakerArrangement mono = {kSpeakerArrMono, 1, {}};
    VstSpeakerArrangement empty = {kSpeakerArrMono, 0, {}};
    VstSpeakerArrangement negative = {kSpeakerArrMono, INT_MIN, {}};
    VstSpeakerArrangement liar = {kSpeakerArrUserDefined, INT_MAX, {}};
    VstSpeakerArrangement large = {kSpeakerArrUserDefined, 65, {}};
    struct Case
    {
        const char* what;
        long long set;
        long long get;
        VstSpeakerArrangement* input;
        VstSpeakerArrangement* output;
    };
    for (const Case& expected :
         {Case{"refused", 0, 1, &mono, &mono}, Case{"not told", 1, 0, &mono, &mono},
          Case{"null", 1, 1, nullptr, nullptr}, Case{"null input", 1, 1, nullptr, &mono},
          Case{"null output", 1, 1, &mono, nullptr}, Case{"no channels", 1, 1, &mono, &empty},
          Case{"negative", 1, 1, &negative, &mono}, Case{"lie", 1, 1, &liar, &mono},
          Case{"lie of the output", 1, 1, &mono, &liar}, Case{"too many", 1, 1, &large, &large}})
    {
        Make(2, 4);
        fake.Return(effSetSpeakerArrangement, expected.set);
        Answer(expected.input, expected.output, expected.get);
        Request(1, 1);
        EXPECT_EQ(Buses(*filter), "Stereo In(2)|Multi-Mono In(4)") << expected.what;
    }
    fake.Throw(effSetSpeakerArrangement);
    Request(1, 1);
    EXPECT_EQ(Buses(*filter), "Stereo In(2)|Multi-Mono In(4)");
    fake.Return(effSetSpeakerArrangement, 1);
    fake.Throw(effGetSpeakerArrangement);
    Request(1, 1);
    EXPECT_EQ(Buses(*filter), "Stereo In(2)|Multi-Mono In(4)");
}

TEST_F(IOConfiguration, OldPluginIsNeverAsked)
{
    for (const long long version : {0LL, 2LL, 2299LL})
    {
        fake.Return(effGetVstVersion, version);
        Make(2, 2);
        Accept();
        Request(1, 1);
        EXPECT_EQ(Buses(*filter), "Stereo In(2)|Stereo Out(2)");
    }
    EXPECT_EQ(fake.Count("effSetSpeakerArrangement"), 0U);
    EXPECT_EQ(fake.Count("effGetSpeakerArrangement"), 0U);
    fake.Return(effGetVstVersion, 2300);
    Request(1, 1);
    EXPECT_EQ(Buses(*filter), "Mono In(1)|Mono Out(1)");
}

TEST_F(IOConfiguration, OtherThanOneLayoutASideChangesNoBusButForgets)
{
    Make(2, 2);
    Accept();
    const ChannelLayout one(1);
    for (const auto& [inputs, outputs] : {std::pair<std::size_t, std::size_t>(2, 1), {1, 2}, {0, 1}, {1, 0}, {0, 0}})
    {
        Request(4, 4);
        fake.ClearCalls();
        filter->RequestIOConfiguration(std::vector(inputs, one), std::vector(outputs, one));
        EXPECT_EQ(Buses(*filter), "Multi-Mono In(4)|Multi-Mono Out(4)");
        EXPECT_TRUE(fake.Calls().empty());
    }
}

TEST_F(IOConfiguration, OfferedArrangementsStayReadable)
{
    Make(2, 2);
    std::vector<const VstSpeakerArrangement*> offered;
    fake.On(effSetSpeakerArrangement,
            [&offered](int, long long value, void* ptr, float)
            {
                offered.push_back(std::bit_cast<const VstSpeakerArrangement*>(value));
                offered.push_back(static_cast<const VstSpeakerArrangement*>(ptr));
                return 0LL;
            });
    for (const std::size_t count : {1U, 3U, 64U})
        Request(count, count + 1);
    filter.reset();
    ASSERT_EQ(offered.size(), 6U);
    const int counts[] = {1, 2, 3, 4, 64, 65};
    for (std::size_t index = 0; index < offered.size(); ++index)
        EXPECT_EQ(offered[index]->numChannels, counts[index]);
    EXPECT_STREQ(offered[2]->speakers[0].name, "3");
}

TEST_F(IOConfiguration, EmptyLayoutDoesNoHarm)
{
    Make(2, 2, effFlagsCanReplacing | effFlagsCanMono);
    Accept();
    Request(0, 0);
    EXPECT_EQ(Buses(*filter), "Stereo In(2)|Stereo Out(2)");
}

TEST_F(IOConfiguration, MonoRunsThroughStereoPinsThatCanMono)
{
    struct Case
    {
        const char* what;
        int flags;
        std::size_t inputs;
        std::size_t outputs;
        int pins;
        const char* buses;
    };
    constexpr int kCanMono = effFlagsCanReplacing | effFlagsCanMono;
    for (const Case& expected : {Case{"can", kCanMono, 1, 1, 2, "Mono In(1)|Mono Out(1)"},
                                 Case{"can't", effFlagsCanReplacing, 1, 1, 2, "Stereo In(2)|Stereo Out(2)"},
                                 Case{"mono to stereo", kCanMono, 1, 2, 2, "Stereo In(2)|Stereo Out(2)"},
                                 Case{"stereo to mono", kCanMono, 2, 1, 2, "Stereo In(2)|Stereo Out(2)"},
                                 Case{"four pins", kCanMono, 1, 1, 4, "Multi-Mono In(4)|Multi-Mono In(4)"},
                                 Case{"one pin", kCanMono, 1, 1, 1, "Mono In(1)|Mono Out(1)"}})
    {
        Make(expected.pins, expected.pins, expected.flags);
        Request(expected.inputs, expected.outputs);
        EXPECT_EQ(Buses(*filter), expected.buses) << expected.what;
    }
}

TEST_F(IOConfiguration, MonoThroughStereoFeedsBothPinsAndEndsWithTheNextRequest)
{
    Make(2, 2, effFlagsCanReplacing | effFlagsCanMono);
    Request(1, 1);
    filter->SetBlockSize(4);
    filter->Resume();
    fake.replace = [](float** inputs, float** outputs, int frames)
    {
        for (int frame = 0; frame < frames; ++frame)
        {
            outputs[0][frame] = inputs[0][frame] + 10 * inputs[1][frame];
            outputs[1][frame] = -1.0F;
        }
    };
    float in[4] = {1, 2, 3, 4};
    float out[4] = {};
    float* inputs[] = {in};
    float* outputs[] = {out};
    ChannelFlags flags;
    filter->Process(inputs, outputs, 4, {}, flags);
    EXPECT_EQ(std::vector<float>(out, out + 4), (std::vector<float>{11, 22, 33, 44}));
    filter->Suspend();

    fake.replace = {};
    Request(2, 2);
    EXPECT_EQ(Buses(*filter), "Stereo In(2)|Stereo Out(2)");
    filter->Resume();
    float right[4] = {5, 6, 7, 8};
    float rightOut[4] = {};
    float* stereoInputs[] = {in, right};
    float* stereoOutputs[] = {out, rightOut};
    filter->Process(stereoInputs, stereoOutputs, 4, {}, flags);
    EXPECT_EQ(std::vector<float>(rightOut, rightOut + 4), std::vector<float>(right, right + 4));
    filter->Suspend();
}

TEST_F(IOConfiguration, SideChainIsKnownByItsChannels)
{
    struct Case
    {
        int inputs;
        int outputs;
        bool sideChain;
    };
    for (const Case& expected : {Case{4, 2, true}, Case{2, 1, true}, Case{3, 2, true}, Case{2, 2, false},
                                 Case{1, 1, false}, Case{4, 4, false}, Case{2, 4, false}, Case{3, 1, false}})
    {
        Make(expected.inputs, expected.outputs);
        EXPECT_EQ(filter->CanUseSideChaining(), expected.sideChain) << expected.inputs << " " << expected.outputs;
    }
}

TEST_F(IOConfiguration, EachStepLeavesItsTrace)
{
    namespace debug = zebcore::debug;
    std::string lines;
    debug::SetTraceSink([&lines](std::string_view line) { lines += line.substr(line.find('V')); }); // less the thread
    debug::SetTraceCategoryEnabled("VST", true);
    debug::SetTraceCategoryEnabled("VSTAudioFilter::RequestIOConfiguration()", true);
    Make(2, 2, effFlagsCanMono);
    Request(1, 1);
    fake.Return(effSetSpeakerArrangement, 1);
    Request(3, 2);
    fake.Return(effGetSpeakerArrangement, 1);
    Request(3, 2);
    debug::SetAllTraceEnabled(false);
    debug::SetTraceSink({});
    const std::string counts =
        "VST> <6> BuildIOConfiguration(), using numInputs/numOutputs, numInputs=2, numOutputs=2\n";
    const std::string request = "VSTAudioFilter::RequestIOConfiguration()> <6> ";
    EXPECT_EQ(lines, counts + request + "effSetSpeakerArrangement failed, inputs= 1, outputs= 1\n" + counts +
                         request + "CanMono\n" + request +
                         "effSetSpeakerArrangement succeeded, inputs= 3, outputs= 2\n" + request +
                         "effGetSpeakerArrangement failed\n" + counts + request +
                         "effSetSpeakerArrangement succeeded, inputs= 3, outputs= 2\n" + request +
                         "effGetSpeakerArrangement succeeded\n" + counts);
}

} // namespace zebaudiofilterhost::vst
