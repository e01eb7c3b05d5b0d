#include "tests/xau/support/CFTestObjects.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gmock/gmock.h>

#include <cstring>
#include <limits>

namespace zebaudiofilterhost::xau
{
namespace
{

using testing::ElementsAre;

class XAUParametersTest : public testing::Test
{
protected:
    static AudioUnitParameterInfo MakeInfo(AudioUnitParameterUnit unit, Float32 minimum, Float32 maximum,
                                           UInt32 flags = 0)
    {
        AudioUnitParameterInfo info = {};
        std::strncpy(info.name, "Narrow", sizeof(info.name) - 1);
        info.unit = unit;
        info.minValue = minimum;
        info.maxValue = maximum;
        info.flags = flags;
        return info;
    }

    // The unit describes its parameter 1 so.
    boost::intrusive_ptr<AudioFilterParameterInfo> Describe(const AudioUnitParameterInfo& info)
    {
        mUnit.AnswerList(Global(kAudioUnitProperty_ParameterList), std::vector<AudioUnitParameterID>{1});
        mUnit.Answer({kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Global, 1}, info);
        mFilter = mUnit.MakeFilter();
        return mFilter->GetParameterInfo(0);
    }

    void AnswerIDs(AudioUnitScope scope, const std::vector<AudioUnitParameterID>& ids)
    {
        mUnit.AnswerList({kAudioUnitProperty_ParameterList, scope, 0}, ids);
    }

    // Scope and ID of each parameter.
    std::vector<std::pair<int, int>> Listed()
    {
        mFilter = mUnit.MakeFilter();
        std::vector<std::pair<int, int>> listed;
        for (int index = 0; index < mFilter->GetParameterCount(); ++index)
        {
            const auto info = boost::dynamic_pointer_cast<XAUParameterInfo>(mFilter->GetParameterInfo(index));
            listed.emplace_back(info->GetScope(), info->GetParameterID());
        }
        return listed;
    }

    TestClock mClock;
    FakeUnit mUnit;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
};

TEST_F(XAUParametersTest, ValuesAreLinearInNormalisedOnes)
{
    auto info = Describe(MakeInfo(kAudioUnitParameterUnit_Decibels, -96.0F, 12.0F));
    EXPECT_FLOAT_EQ(info->ToNormalized(-42.0F), 0.5F);
    EXPECT_FLOAT_EQ(info->FromNormalized(0.5F), -42.0F);
    info = Describe(MakeInfo(kAudioUnitParameterUnit_Generic, 3.0F, 3.0F));
    EXPECT_FLOAT_EQ(info->ToNormalized(5.0F), 2.0F) << "no range counts as 1";
    EXPECT_FLOAT_EQ(info->FromNormalized(2.0F), 5.0F);
    info = Describe(MakeInfo(kAudioUnitParameterUnit_Generic, 3.0F, 1.0F));
    EXPECT_FLOAT_EQ(info->ToNormalized(4.0F), 1.0F);
}

TEST_F(XAUParametersTest, ARangeWiderThanAFloatHasValuesNonetheless)
{
    constexpr float kMost = std::numeric_limits<float>::max();
    const auto info = Describe(MakeInfo(kAudioUnitParameterUnit_Generic, -kMost, kMost));
    for (const auto& [normalized, value] :
         {std::pair(0.0F, -kMost), std::pair(0.25F, -kMost / 2.0F), std::pair(0.5F, 0.0F), std::pair(1.0F, kMost)})
    {
        EXPECT_EQ(info->FromNormalized(normalized), value);
        EXPECT_EQ(info->ToNormalized(value), normalized);
    }
    EXPECT_EQ(info->FromNormalized(2.0F), kMost);
    EXPECT_EQ(info->FromNormalized(-1.0F), -kMost);
}

TEST_F(XAUParametersTest, UnitsBecomeLabelsAndSteps)
{
    const std::map<AudioUnitParameterUnit, UTF16String> labels = {
        {3, u"%"},   {4, u"s"},  {5, u"Samples"}, {6, u"o"},      {8, u"Hz"},   {9, u"Cents"}, {10, u"S-T"},
        {13, u"dB"}, {15, u"o"}, {19, u"m"},      {20, u"Cents"}, {21, u"Oct"}, {22, u"BPM"},  {24, u"ms"}};
    for (AudioUnitParameterUnit unit = 0; unit < 30; ++unit)
    {
        const auto info = Describe(MakeInfo(unit, 0.0F, 3.9F));
        const auto found = labels.find(unit);
        EXPECT_EQ(info->GetLabel(), found == labels.end() ? UTF16String() : found->second) << unit;
        EXPECT_EQ(info->GetStepCount(), unit == 1 ? 3 : unit == 2 ? 1 : 0) << unit;
    }
    EXPECT_EQ(Describe(MakeInfo(kAudioUnitParameterUnit_Indexed, 0.0F, 100000.0F))->GetStepCount(), 100000);
    EXPECT_GE(Describe(MakeInfo(kAudioUnitParameterUnit_Indexed, -3e38F, 3e38F))->GetStepCount(), 0);
}

TEST_F(XAUParametersTest, FlagsSayWhatIsShownAndRamped)
{
    auto info = Describe(MakeInfo(0, 0.0F, 1.0F));
    EXPECT_TRUE(info->CanBeAutomated() && info->IsExposed());
    EXPECT_FALSE(info->CanRamp());
    info = Describe(MakeInfo(0, 0.0F, 1.0F, kAudioUnitParameterFlag_NonRealTime | kAudioUnitParameterFlag_CanRamp));
    EXPECT_FALSE(info->CanBeAutomated() || info->IsExposed());
    EXPECT_TRUE(info->CanRamp());
}

TEST_F(XAUParametersTest, NamesAreReleasedWhereTheUnitSaysSoAndNowhereElse)
{
    struct Case
    {
        UInt32 flags;
        AudioUnitParameterUnit unit;
        bool releasesName;
        bool releasesUnitName;
        UTF16String name;
        UTF16String label;
    };
    constexpr UInt32 kHasName = kAudioUnitParameterFlag_HasCFNameString;
    constexpr UInt32 kRelease = kAudioUnitParameterFlag_CFNameRelease;
    constexpr AudioUnitParameterUnit kCustom = kAudioUnitParameterUnit_CustomUnit;
    for (const Case& c : {Case{kHasName | kRelease, kCustom, true, true, u"Wide", u"Beans"},
                          Case{kHasName | kRelease, 0, true, false, u"Wide", u""},
                          Case{kHasName, kCustom, false, false, u"Wide", u"Beans"},
                          Case{kRelease, kCustom, false, true, u"Narrow", u"Beans"},
                          Case{kRelease, 0, false, false, u"Narrow", u""}, Case{0, 0, false, false, u"Narrow", u""}})
    {
        const CFOwner name(MakeString("Wide"));
        const CFOwner unitName(MakeString("Beans"));
        AudioUnitParameterInfo info = MakeInfo(c.unit, 0.0F, 1.0F, c.flags);
        info.cfNameString = static_cast<CFStringRef>(CFRetain(name.get()));
        info.unitName = static_cast<CFStringRef>(CFRetain(unitName.get()));
        const auto read = Describe(info);
        EXPECT_EQ(read->GetName(), c.name) << c.flags;
        EXPECT_EQ(read->GetLabel(), c.label) << c.flags;
        EXPECT_EQ(CFGetRetainCount(name.get()), c.releasesName ? 1 : 2) << c.flags;
        EXPECT_EQ(CFGetRetainCount(unitName.get()), c.releasesUnitName ? 1 : 2) << c.flags;
        for (const auto& [object, released] :
             {std::pair(name.get(), c.releasesName), {unitName.get(), c.releasesUnitName}})
        {
            if (!released)
                CFRelease(object);
        }
    }
}

TEST_F(XAUParametersTest, OddNamesAreEmptyOrCut)
{
    AudioUnitParameterInfo info =
        MakeInfo(kAudioUnitParameterUnit_CustomUnit, 0.0F, 1.0F,
                 kAudioUnitParameterFlag_HasCFNameString | kAudioUnitParameterFlag_CFNameRelease);
    EXPECT_EQ(Describe(info)->GetName(), u"");
    EXPECT_EQ(Describe(info)->GetLabel(), u"");
    info = MakeInfo(0, 0.0F, 1.0F);
    std::memset(info.name, 'x', sizeof(info.name)); // no zero at the end
    EXPECT_EQ(Describe(info)->GetName(), UTF16String(52, u'x'));
}

TEST_F(XAUParametersTest, AParameterThatIsNotDescribedHasNoRange)
{
    AnswerIDs(kAudioUnitScope_Global, {9});
    mFilter = mUnit.MakeFilter();
    const auto info = mFilter->GetParameterInfo(0);
    EXPECT_EQ(info->GetName(), u"");
    EXPECT_FLOAT_EQ(info->ToNormalized(0.25F), 0.25F);
    EXPECT_TRUE(info->CanBeAutomated());
    EXPECT_EQ(mFilter->GetParameter(0), 0.0F) << "nor a value";
}

// The list always is that of the global scope, as long as the scope at hand says.
TEST_F(XAUParametersTest, EveryScopeReadsTheGlobalListAsLongAsItsOwn)
{
    using Listing = std::vector<std::pair<int, int>>;
    EXPECT_EQ(Listed(), Listing());
    AnswerIDs(kAudioUnitScope_Global, {10, 11, 12});
    EXPECT_EQ(Listed(), (Listing{{0, 10}, {0, 11}, {0, 12}}));
    AnswerIDs(kAudioUnitScope_Input, {70, 71});
    AnswerIDs(kAudioUnitScope_Note, {80, 81, 82, 83, 84});
    EXPECT_EQ(Listed(), (Listing{{0, 10}, {0, 11}, {0, 12}, {1, 10}, {1, 11}, {5, 10}, {5, 11}, {5, 12}}));
    mUnit.mAnnounced[Global(kAudioUnitProperty_ParameterList)] = 400;
    EXPECT_EQ(Listed().size(), 8U) << "what was read counts";
    mUnit.mAnnounced[Global(kAudioUnitProperty_ParameterList)] = 0xFFFFFFFF;
    EXPECT_EQ(Listed().size(), 8U);
}

TEST_F(XAUParametersTest, ValuesGoToTheScopeOfTheParameter)
{
    AnswerIDs(kAudioUnitScope_Global, {10});
    AnswerIDs(kAudioUnitScope_Output, {20});
    mUnit.Answer({kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Output, 10}, MakeInfo(0, 0.0F, 4.0F));
    mFilter = mUnit.MakeFilter();
    ASSERT_EQ(mFilter->GetParameterCount(), 2);
    mFilter->SetParameter(1, 0.5F);
    EXPECT_EQ((mUnit.mValues[{kAudioUnitScope_Output, 10}]), 2.0F);
    EXPECT_EQ(mFilter->GetParameter(1), 0.5F);
    EXPECT_EQ(mFilter->GetParameter(2), 0.0F);
    EXPECT_EQ(mFilter->GetParameter(-1), 0.0F);
    EXPECT_FALSE(mFilter->GetParameterInfo(2));
    EXPECT_EQ(mFilter->GetParameterString(2), u"");
}

TEST_F(XAUParametersTest, WhatAUnitThrowsIsAFailure)
{
    AnswerIDs(kAudioUnitScope_Global, {10});
    mUnit.Answer({kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Global, 10}, MakeInfo(0, 1.0F, 4.0F));
    mFilter = mUnit.MakeFilter();
    mUnit.mThrowsIn = {"get parameter", "set parameter"};
    const auto count = mFilter->GetParameterDirtyCount();
    mFilter->SetParameter(0, 0.5F);
    EXPECT_NE(mFilter->GetParameterDirtyCount(), count) << "it was set, and failed";
    mFilter->GetParameter(0);
    mUnit.mThrowsIn.clear();
    mUnit.mValues[{kAudioUnitScope_Global, 10}] = 4.0F;
    EXPECT_EQ(mFilter->GetParameter(0), 1.0F);
}

// Units announce nothing for a scope or a list that they have, and then write it whole.
TEST_F(XAUParametersTest, AListLongerThanAnnouncedHasRoom)
{
    AnswerIDs(kAudioUnitScope_Global, std::vector<AudioUnitParameterID>(1500, 10));
    AnswerIDs(kAudioUnitScope_Output, {});
    mUnit.mIgnoresAnnouncedSize = true;
    EXPECT_EQ(Listed().size(), 1500U);

    mUnit.AnswerList(Global(kAudioUnitProperty_SupportedNumChannels), std::vector<AUChannelInfo>(900, {1, 1}));
    mUnit.mAnnounced[Global(kAudioUnitProperty_SupportedNumChannels)] = 0;
    mFilter = mUnit.MakeFilter();
    mFilter->RequestIOConfiguration({ChannelLayout(1)}, {ChannelLayout(1)});
    EXPECT_TRUE(mFilter->GetInputBuses().empty()) << "nothing was announced";
}

TEST_F(XAUParametersTest, TextsAreTheUnitsOwnAndStayItsOwn)
{
    Describe(MakeInfo(0, 0.0F, 4.0F));
    mFilter->SetParameter(0, 0.625F);
    EXPECT_EQ(mFilter->GetParameterString(0), u"2.5");
    const CFOwner text(MakeString("two and a half"));
    const AudioUnitParameterStringFromValue answer = {1, nullptr, static_cast<CFStringRef>(text.get())};
    mUnit.Answer(Global(kAudioUnitProperty_ParameterStringFromValue), answer);
    EXPECT_EQ(mFilter->GetParameterString(0), u"two and a half");
    EXPECT_EQ(CFGetRetainCount(text.get()), 1);
    mUnit.Answer(Global(kAudioUnitProperty_ParameterStringFromValue), AudioUnitParameterStringFromValue{});
    EXPECT_EQ(mFilter->GetParameterString(0), u"");
}

} // namespace
} // namespace zebaudiofilterhost::xau
