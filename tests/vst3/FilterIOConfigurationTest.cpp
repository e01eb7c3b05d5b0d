// Buses of a VST 3 filter, and its description for the catalogue.

#include "host/AudioFilterDescriptor.h"
#include "host/VST3/VST3Technology.h"
#include "tests/vst3/FakePlugin.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cstring>
#include <vector>

using namespace fakeplugin;
using testing::ElementsAre;
using zebaudiofilterhost::AudioChannelLabel;
using zebaudiofilterhost::AudioFilterBusDescription;
using zebaudiofilterhost::ChannelFlags;
using zebaudiofilterhost::ChannelLayout;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::UTF16String;

namespace
{

// "name(channels,type)" of each bus.
std::u16string Describe(const std::vector<AudioFilterBusDescription>& buses)
{
    std::u16string text;
    for (const AudioFilterBusDescription& bus : buses)
    {
        const std::string numbers =
            "(" + std::to_string(bus.GetChannelCount()) + "," + std::to_string(bus.GetType()) + ")";
        text += bus.GetName() + std::u16string(numbers.begin(), numbers.end());
    }
    return text;
}

ChannelLayout Unlabelled(std::size_t channels)
{
    return ChannelLayout(channels, static_cast<AudioChannelLabel>(77));
}

} // namespace

TEST(FilterIOConfiguration, BusesAreNamedByThePluginOrTheirArrangement)
{
    FakePlugin plugin;
    plugin.inputs = {{SpeakerArr::kStereo, u"In"},
                     {SpeakerArr::kMono, u"", kAux},
                     {SpeakerArr::k51},
                     {SpeakerArrangement(3) << 50},
                     {0}};
    plugin.outputs = {{SpeakerArr::kStereo, UTF16String(300, u'o')}};
    const auto filter = plugin.MakeFilter();
    const std::u16string text = Describe(filter->GetInputBuses());
    EXPECT_TRUE(text.starts_with(u"In(2,0)Mono(1,1)5.1(6,0)"));
    ASSERT_EQ(filter->GetInputBuses().size(), 4U); // an empty arrangement is no bus
    EXPECT_TRUE(filter->GetInputBuses()[3].GetName() == AudioChannelLayoutDescription(ChannelLayout(2)));
    EXPECT_TRUE(Describe(filter->GetOutputBuses()) == UTF16String(128, u'o') + u"(2,0)");
}

TEST(FilterIOConfiguration, BusWithoutDescriptionStaysAndWithoutArrangementGoes)
{
    FakePlugin plugin;
    plugin.inputs = {{SpeakerArr::kMono, u"Lost", kMain, kResultOk, kResultFalse},
                     {SpeakerArr::kStereo, u"Unseen", kAux, kResultFalse}};
    plugin.outputs.clear();
    const auto filter = plugin.MakeFilter();
    EXPECT_TRUE(Describe(filter->GetInputBuses()) == u"Stereo(2,0)");
    EXPECT_THAT(plugin.CallsTo("component.activateBus"), ElementsAre("component.activateBus in 0 1"));
}

TEST(FilterIOConfiguration, OnlyMainBusesAreSwitchedOn)
{
    FakePlugin plugin;
    plugin.inputs = {{SpeakerArr::kStereo}, {SpeakerArr::kMono, u"Key", kAux}};
    plugin.outputs = {{SpeakerArr::kStereo, u"", kAux}, {SpeakerArr::kStereo}};
    const auto filter = plugin.MakeFilter();
    EXPECT_THAT(plugin.CallsTo("component.activateBus"),
                ElementsAre("component.activateBus in 0 1", "component.activateBus out 1 1"));
}

TEST(FilterIOConfiguration, CountsThatLieAreNotBelieved)
{
    FakePlugin plugin;
    plugin.audioBusCount = 2147483647;
    const auto filter = plugin.MakeFilter();
    EXPECT_EQ(filter->GetInputBuses().size(), 1U);
    EXPECT_EQ(filter->GetOutputBuses().size(), 1U);
    filter->Resume();
    filter->Suspend();
    plugin.audioBusCount = -3;
    EXPECT_TRUE(plugin.MakeFilter()->GetInputBuses().empty());
}

TEST(FilterIOConfiguration, RequestsBecomeArrangements)
{
    struct Case
    {
        std::vector<ChannelLayout> inputs;
        std::vector<ChannelLayout> outputs;
        std::string call; // empty: none
    };
    const ChannelLayout mono = zebmediatypes::CreateMonoChannelLayout();
    const ChannelLayout stereo = zebmediatypes::CreateStereoChannelLayout();
    for (const Case& request :
         {Case{{stereo}, {mono}, "processor.setBusArrangements 3 -> 524288"},
          Case{{stereo, Unlabelled(3), Unlabelled(4)}, {stereo}, "processor.setBusArrangements 3 51 -> 3"},
          Case{{Unlabelled(3)}, {stereo}, ""}, Case{{stereo}, {}, ""}, Case{{}, {stereo}, ""}})
    {
        FakePlugin plugin;
        const auto filter = plugin.MakeFilter();
        filter->RequestIOConfiguration(request.inputs, request.outputs);
        const auto calls = plugin.CallsTo("processor.setBusArrangements");
        EXPECT_EQ(calls.empty() ? "" : calls.front(), request.call);
    }
}

TEST(FilterIOConfiguration, RefusedRequestLeavesTheBuses)
{
    FakePlugin plugin;
    const auto filter = plugin.MakeFilter();
    const ChannelLayout mono = zebmediatypes::CreateMonoChannelLayout();
    plugin.setArrangementsResult = kResultFalse;
    filter->RequestIOConfiguration({mono}, {mono});
    EXPECT_EQ(filter->GetNumberOfInputChannels(), 2);
    plugin.setArrangementsResult = kResultOk;
    plugin.ClearCalls();
    filter->RequestIOConfiguration({mono}, {mono});
    EXPECT_EQ(filter->GetNumberOfInputChannels(), 1);
    EXPECT_EQ(plugin.CallsTo("component.activateBus").size(), 2U);
}

// As the interface has it: the plug-in comes as near as it can, and refuses all the same.
TEST(FilterIOConfiguration, PluginThatRefusesAndFollowsStaysWithinItsBuffers)
{
    constexpr int kFrames = 3000;
    constexpr int kOwnChannels = 8; // the filter keeps its two
    FakePlugin plugin;
    const auto filter = plugin.MakeFilter();
    plugin.setArrangementsResult = kResultFalse;
    const ChannelLayout stereo = zebmediatypes::CreateStereoChannelLayout();
    filter->RequestIOConfiguration({stereo}, {stereo});
    filter->SetBlockSize(kFrames);
    filter->Resume();
    plugin.process = [](ProcessData& data)
    {
        for (int channel = 0; channel < kOwnChannels; ++channel)
        {
            const float* const in = data.inputs[0].channelBuffers32[channel];
            float* const out = data.outputs[0].channelBuffers32[channel];
            for (int32 frame = 0; frame < data.numSamples; ++frame)
                out[frame] = channel < 2 ? 2 * in[frame] : in[frame] + 1;
        }
        return kResultOk;
    };
    std::vector<float> left(kFrames, 0.5F);
    std::vector<float> right(kFrames, 0.25F);
    std::array<float*, 2> channels = {left.data(), right.data()};
    ChannelFlags silent;
    for (int block = 0; block < 2; ++block) // the second finds what the first has written beside its buses
        filter->ProcessWithMapping(channels.data(), channels.data(), kFrames, ChannelFlags(), silent);
    EXPECT_THAT(left, testing::Each(2.0F));
    EXPECT_THAT(right, testing::Each(1.0F));
    filter->Suspend();
}

TEST(FilterIOConfiguration, SubCategoriesDecideInTheirOrder)
{
    struct Case
    {
        const char* subCategories;
        int category;
        bool synth;
    };
    for (const Case& expected : {Case{"Fx|Reverb|Fx|Delay", 12, false},
                                 Case{"Fx|Reverb", 24, false},
                                 Case{"Fx|Analyzer", 11, false},
                                 Case{"Fx|Dynamics", 14, false},
                                 Case{"Fx|Mastering", 20, false},
                                 Case{"Fx|Restoration", 23, false},
                                 Case{"Fx|Generator", 19, false},
                                 Case{"Fx|Spatial", 18, false},
                                 Case{"Fx|Distortion", 13, false},
                                 Case{"Fx|EQ", 15, false},
                                 Case{"Fx|Filter", 16, false},
                                 Case{"Fx|Modulation", 21, false},
                                 Case{"Fx|Pitch Shift", 22, false},
                                 Case{"Fx|Surround", 25, false},
                                 Case{"Fx|Tools", 26, false},
                                 Case{"Stereo|Fx|Vocals", 1, false},
                                 Case{"Fx|Instrument", 1, false},
                                 Case{"Instrument|Synth", 17, true},
                                 Case{"Spatial", 0, false},
                                 Case{"", 0, false}})
    {
        FakePlugin plugin;
        strncpy8(plugin.classInfo2.subCategories, expected.subCategories, PClassInfo2::kSubCategoriesSize);
        const auto descriptor = plugin.MakeFilter()->CreateFilterDescriptor(PluginLocator(), false);
        EXPECT_EQ(static_cast<int>(descriptor->GetCategory()), expected.category) << expected.subCategories;
        EXPECT_EQ(descriptor->IsSynth(), expected.synth) << expected.subCategories;
    }
}

TEST(FilterIOConfiguration, DescriptorTellsWhatTheFilterIs)
{
    FakePlugin plugin;
    strncpy8(plugin.classInfo2.subCategories, "Instrument", PClassInfo2::kSubCategoriesSize);
    const PluginLocator locator(zebaudiofilterhost::kTechnologyVST3, u"/a.vst3");
    const auto filter = plugin.MakeFilter();
    plugin.ClearCalls();
    const auto descriptor = filter->CreateFilterDescriptor(locator, true);
    EXPECT_TRUE(descriptor->GetLocator() == locator);
    EXPECT_TRUE(descriptor->GetName() == u"Class Two");
    EXPECT_TRUE(descriptor->GetVendorString() == u"Vendor Two");
    EXPECT_EQ(descriptor->GetVersion(), 0U);
    EXPECT_EQ(descriptor->GetCategory(), zebaudiofilterhost::kCategoryNotQueried);
    EXPECT_FALSE(descriptor->IsSynth());
    EXPECT_TRUE(descriptor->GetUniqueID() == filter->GetID());
    EXPECT_TRUE(descriptor->GetFactoryGuid() == zebaudiofilterhost::vst3::GetVST3FactoryGuid());
    EXPECT_TRUE(descriptor->GetSupportsMono());
    EXPECT_TRUE(descriptor->GetSupportsStereo());
    EXPECT_THAT(plugin.CallsTo("processor.setBusArrangements"),
                ElementsAre("processor.setBusArrangements 524288 -> 524288", "processor.setBusArrangements 3 -> 3"));

    plugin.setArrangementsResult = kResultFalse; // it stays in stereo
    const auto stubborn = filter->CreateFilterDescriptor(locator, true);
    EXPECT_FALSE(stubborn->GetSupportsMono());
    EXPECT_TRUE(stubborn->GetSupportsStereo());
}
