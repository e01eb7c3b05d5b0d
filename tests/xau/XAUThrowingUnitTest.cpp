// Units that throw: each call counts as one that failed, and the filter goes on as after any other failure.

#include "audiofilter/PresetData.h"
#include "host/AudioFilterDescriptor.h"
#include "host/PluginLocator.h"
#include "tests/xau/support/CFTestObjects.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gtest/gtest.h>

#include <array>

namespace zebaudiofilterhost::xau
{
namespace
{

class XAUThrowingUnitTest : public testing::Test
{
protected:
    XAUThrowingUnitTest() { mUnit.SetParameters({5}, 0.0F, 10.0F); }

    void Make()
    {
        mFilter = mUnit.MakeFilter();
        ASSERT_TRUE(mFilter);
        mFilter->RequestIOConfiguration(mStereo, mStereo);
    }

    void Process(int frames)
    {
        std::vector<float> samples(static_cast<std::size_t>(frames));
        std::array<float*, 2> channels = {samples.data(), samples.data()};
        ChannelFlags flags;
        mFilter->Process(channels.data(), channels.data(), frames, {}, flags);
    }

    double GetUnitRate(AudioUnitScope scope) const
    {
        return mUnit.Read<AudioStreamBasicDescription>(FormatOf(scope)).mSampleRate;
    }

    const std::vector<ChannelLayout> mStereo{zebmediatypes::CreateStereoChannelLayout()};
    TestClock mClock;
    FakeUnit mUnit;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
};

TEST_F(XAUThrowingUnitTest, WithoutAnInstanceThereIsNoFilter)
{
    for (const char* call : {"create", "open"})
    {
        mUnit.mThrowsIn = {call};
        EXPECT_FALSE(mUnit.MakeFilter()) << call;
    }
    EXPECT_EQ(mUnit.CountCalls("close"), 0U);
}

TEST_F(XAUThrowingUnitTest, WhatIsThrownWhileAFilterIsMadeIsMadeUpForByResume)
{
    for (const char* call : {"get property info", "get property", "set property", "initialize"})
    {
        mUnit.mThrowsIn = {call};
        mFilter = mUnit.MakeFilter();
        ASSERT_TRUE(mFilter) << call;
        mUnit.mThrowsIn.clear();
        mFilter->RequestIOConfiguration(mStereo, mStereo);
        mFilter->Resume();
        EXPECT_TRUE(mFilter->IsAUInitialized()) << call;
        mUnit.mCalls.clear();
        Process(8);
        EXPECT_EQ(mUnit.CountCalls("render 8"), 1U) << call;
    }
}

TEST_F(XAUThrowingUnitTest, ResumeMakesTheBuffersAllTheSame)
{
    Make();
    mFilter->UninitializeAU();
    mUnit.mThrowsIn = {"initialize", "reset", "set property"};
    mFilter->Resume();
    EXPECT_FALSE(mFilter->IsAUInitialized());
    EXPECT_EQ(mUnit.CountCalls("reset 0 0"), 1U);
    Process(8);
    EXPECT_EQ(mUnit.CountCalls("render 8"), 0U);
    mUnit.mThrowsIn.clear();
    mFilter->InitializeAU();
    Process(8);
    EXPECT_EQ(mUnit.CountCalls("render 8"), 1U);
}

TEST_F(XAUThrowingUnitTest, RatesAndSizesReachAUnitThatThrowsBeforeThem)
{
    Make();
    mUnit.mThrowsIn = {"uninitialize"};
    mFilter->SetSampleRate(96000.0F);
    EXPECT_EQ(GetUnitRate(kAudioUnitScope_Input), 96000.0);
    EXPECT_EQ(GetUnitRate(kAudioUnitScope_Output), 96000.0);
    mFilter->SetBlockSize(256);
    EXPECT_EQ(mUnit.Read<UInt32>(Global(kAudioUnitProperty_MaximumFramesPerSlice)), 256U);
    EXPECT_TRUE(mFilter->IsAUInitialized()) << "again";
    mFilter->UninitializeAU();
    EXPECT_FALSE(mFilter->IsAUInitialized());
    mUnit.mCalls.clear();
    mFilter->UninitializeAU();
    EXPECT_TRUE(mUnit.mCalls.empty()) << "once is enough";
}

TEST_F(XAUThrowingUnitTest, FormatsThatCannotBeSetChangeNothing)
{
    Make();
    const double rate = GetUnitRate(kAudioUnitScope_Input);
    mUnit.mThrowsIn = {"set property"};
    mFilter->SetSampleRate(96000.0F);
    mFilter->SetBlockSize(256);
    EXPECT_NE(mFilter->SetStreamFormat(kAudioUnitScope_Input, 0, {}), noErr);
    EXPECT_EQ(GetUnitRate(kAudioUnitScope_Input), rate);
    mFilter->RequestIOConfiguration({ChannelLayout(1)}, {ChannelLayout(1)});
    EXPECT_EQ(mFilter->GetNumberOfInputChannels(), 2) << "the buses tell the truth";
    EXPECT_TRUE(mFilter->IsAUInitialized());
}

TEST_F(XAUThrowingUnitTest, WhatCannotBeReadIsNotThere)
{
    mUnit.Answer(Global(kAudioUnitProperty_Latency), Float64{0.5});
    mUnit.Answer(Global(kAudioUnitProperty_CocoaUI), std::array<void*, 2>());
    Make();
    mUnit.mThrowsIn = {"get property", "get property info", "get parameter"};
    EXPECT_EQ(mFilter->GetInitialDelay(), 0);
    EXPECT_EQ(mFilter->GetElementCount(kAudioUnitScope_Input), 0U);
    AudioStreamBasicDescription format = {};
    EXPECT_NE(mFilter->GetStreamFormat(kAudioUnitScope_Input, 0, format), noErr);
    ChannelLayout layout;
    EXPECT_FALSE(mFilter->GetAudioChannelLayout(kAudioUnitScope_Input, 0, layout));
    EXPECT_EQ(mFilter->GetParameterString(0), u"0");
    EXPECT_TRUE(mFilter->CreateFilterDescriptor(PluginLocator(), false));
    EXPECT_TRUE(mFilter->CreateCustomEditor());
    mFilter->RequestIOConfiguration(mStereo, mStereo);
    EXPECT_TRUE(mFilter->GetInputBuses().empty());
}

TEST_F(XAUThrowingUnitTest, WhatCanBeReadOfBusesAndParametersIsThere)
{
    constexpr auto kInput = kAudioUnitScope_Input;
    const CFOwner name(MakeString("Mine"));
    mUnit.Answer({kAudioUnitProperty_ElementName, kInput, 0}, name.get());
    mUnit.Answer({kAudioUnitProperty_AudioChannelLayout, kInput, 0},
                 ::AudioChannelLayout{kAudioChannelLayoutTag_MPEG_5_1_A, 0, 0, {}});
    mUnit.AnswerList(Global(kAudioUnitProperty_SupportedNumChannels), std::vector<AUChannelInfo>{{1, 1}});
    struct Case
    {
        AudioUnitPropertyID property;
        const char16_t* name;
        int channels;
        float parameter; // its value at twice the range
    };
    for (const Case& expected : {Case{kAudioUnitProperty_ElementName, u"Input", 6, 20.0F},
                                 Case{kAudioUnitProperty_AudioChannelLayout, u"Mine", 1, 20.0F},
                                 Case{kAudioUnitProperty_SupportedNumChannels, u"Mine", 6, 20.0F},
                                 Case{kAudioUnitProperty_ParameterInfo, u"Mine", 6, 2.0F}})
    {
        if (expected.property != kAudioUnitProperty_ElementName)
            CFRetain(name.get()); // for the filter, which reads it
        mUnit.mThrowsOf = {expected.property};
        ASSERT_NO_FATAL_FAILURE(Make()) << expected.property;
        mUnit.mThrowsOf.clear();
        ASSERT_EQ(mFilter->GetInputBuses().size(), 1U);
        EXPECT_EQ(mFilter->GetInputBuses().front().GetName(), expected.name) << expected.property;
        EXPECT_EQ(mFilter->GetNumberOfInputChannels(), expected.channels) << expected.property;
        ASSERT_TRUE(mFilter->GetParameterInfo(0));
        EXPECT_EQ(mFilter->GetParameterInfo(0)->FromNormalized(2.0F), expected.parameter) << expected.property;
    }
    EXPECT_EQ(CFGetRetainCount(name.get()), 1);
}

TEST_F(XAUThrowingUnitTest, PresetsAreNeitherSavedNorLoaded)
{
    const CFOwner name(MakeString("Hall"));
    const AUPreset record = {7, static_cast<CFStringRef>(name.get())};
    const void* pointer = &record;
    mUnit.Answer(Global(kAudioUnitProperty_FactoryPresets), CFArrayCreate(nullptr, &pointer, 1, nullptr));
    mUnit.Answer(Global(kAudioUnitProperty_ClassInfo), static_cast<CFPropertyListRef>(kCFBooleanTrue));
    Make();
    PropList list;
    PresetData preset(list);
    ASSERT_TRUE(mFilter->SaveChunkData(preset));
    int told = 0;
    const boost::signals2::scoped_connection connection =
        mFilter->GetAutomatedParameterChangeSignal().connect([&](int, float) { ++told; });
    mUnit.mThrowsIn = {"get property", "set property"};
    PropList otherList;
    PresetData other(otherList);
    EXPECT_FALSE(mFilter->SaveChunkData(other));
    EXPECT_TRUE(other.IsEmpty());
    EXPECT_FALSE(mFilter->LoadChunkData(preset));
    mFilter->SetFactoryPreset(0);
    mClock.Pass(50);
    EXPECT_EQ(told, 0) << "nothing has changed";
}

TEST_F(XAUThrowingUnitTest, IsDisposedOfWhereItThrowsInTheEnd)
{
    const CFOwner presets(CFArrayCreate(nullptr, nullptr, 0, nullptr));
    CFRetain(presets.get()); // for the filter
    mUnit.Answer(Global(kAudioUnitProperty_FactoryPresets), presets.get());
    Make();
    mUnit.mThrowsIn = {"uninitialize", "close"};
    mUnit.mCalls.clear();
    mFilter.reset();
    EXPECT_EQ(mUnit.mCalls, (std::vector<std::string>{"uninitialize", "close"}));
    EXPECT_EQ(CFGetRetainCount(presets.get()), 1);
}

} // namespace
} // namespace zebaudiofilterhost::xau
