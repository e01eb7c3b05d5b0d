#include "host/src/VST/src/VSTParameterInfo.h"

#include "foundation/zebcore/Error.h"
#include "tests/vst/support/FakeEffect.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gtest/gtest.h>

#include <cstring>
#include <limits>
#include <string>

namespace zebaudiofilterhost::vst
{

namespace
{

using fakeeffect::FakeEffect;

void Describe(FakeEffect& fake, const VstParameterProperties& properties)
{
    fake.On(effGetParameterProperties,
            [properties](int, long long, void* ptr, float)
            {
                *static_cast<VstParameterProperties*>(ptr) = properties;
                return 1LL;
            });
}

boost::intrusive_ptr<VSTParameterInfo> MakeInfo(FakeEffect& fake, int index = 3)
{
    return new VSTParameterInfo(fake.Get(), index);
}

// Fills the buffer that the host is known to have.
void FillUnterminated(FakeEffect& fake, AEffectOpcodes opcode, std::size_t size)
{
    fake.On(opcode,
            [size](int, long long, void* ptr, float)
            {
                std::memset(ptr, 'x', size);
                return 1LL;
            });
}

TEST(VSTParameterInfo, NamesComeFromThePlugin)
{
    FakeEffect fake;
    fake.Text(effGetParamName, "Caf\xc3\xa9 \xff");
    fake.Text(effGetParamLabel, "\xc2\xb5s");
    const auto info = MakeInfo(fake);
    EXPECT_TRUE(info->GetName() == u"Caf\u00e9 \ufffd");
    EXPECT_TRUE(info->GetLabel() == u"\u00b5s");
    EXPECT_EQ(info->GetUnit(), AudioFilterParameterInfoUnit());
    EXPECT_TRUE(info->IsExposed());
    for (const fakeeffect::Call& call : fake.Calls())
        EXPECT_EQ(call.index, 3) << call.name;

    VstParameterProperties properties = {};
    std::strcpy(properties.label, "dB");
    Describe(fake, properties);
    fake.ClearCalls();
    EXPECT_TRUE(MakeInfo(fake)->GetLabel() == u"dB");
    EXPECT_EQ(fake.Count("effGetParamLabel"), 0U) << "the properties are enough";
}

TEST(VSTParameterInfo, TextsWithoutEndFitTheirBuffers)
{
    FakeEffect fake;
    FillUnterminated(fake, effGetParamName, 128);
    FillUnterminated(fake, effGetParamLabel, 128);
    FillUnterminated(fake, effGetParamDisplay, 128);
    const auto info = MakeInfo(fake);
    const UTF16String full(128, u'x');
    EXPECT_TRUE(info->GetName() == full);
    EXPECT_TRUE(info->GetLabel() == full);
    EXPECT_TRUE(info->GetParameterString(0.0F) == full);

    VstParameterProperties properties = {};
    std::memset(properties.label, 'l', sizeof(properties.label));
    properties.flags = kVstParameterIsSwitch;
    Describe(fake, properties);
    EXPECT_TRUE(MakeInfo(fake)->GetLabel() == UTF16String(64, u'l'));
}

TEST(VSTParameterInfo, IntegerRangeScalesTheValue)
{
    struct Case
    {
        int flags;
        int minimum;
        int maximum;
        float real;
        float normalized;
    };
    constexpr int kLowest = std::numeric_limits<int>::min();
    constexpr int kHighest = std::numeric_limits<int>::max();
    for (const Case& expected : {Case{kVstParameterUsesIntegerMinMax, 0, 10, 5.0F, 0.5F},
                                 Case{kVstParameterUsesIntegerMinMax, -20, 20, -10.0F, 0.25F},
                                 Case{kVstParameterUsesIntegerMinMax, 10, 0, 10.0F, 0.0F},
                                 Case{kVstParameterUsesIntegerMinMax, 10, 0, 0.0F, 1.0F},
                                 Case{kVstParameterUsesIntegerMinMax, 5, 5, 0.7F, 0.7F},
                                 Case{kVstParameterUsesIntegerMinMax, kLowest, kHighest, 0.0F, 0.5F},
                                 Case{kVstParameterUsesIntStep, 0, 10, 0.7F, 0.7F}})
    {
        FakeEffect fake;
        VstParameterProperties properties = {};
        properties.flags = expected.flags;
        properties.minInteger = expected.minimum;
        properties.maxInteger = expected.maximum;
        Describe(fake, properties);
        const auto info = MakeInfo(fake);
        EXPECT_FLOAT_EQ(info->ToNormalized(expected.real), expected.normalized) << expected.minimum;
        EXPECT_FLOAT_EQ(info->FromNormalized(expected.normalized), expected.real) << expected.minimum;
    }
}

TEST(VSTParameterInfo, StepsAndRampFollowTheFlags)
{
    struct Case
    {
        int flags;
        int stepInteger;
        int steps;
        bool ramps;
    };
    for (const Case& expected :
         {Case{0, 7, 0, false}, Case{kVstParameterUsesIntStep, 7, 7, false}, Case{kVstParameterIsSwitch, 7, 1, false},
          Case{kVstParameterIsSwitch | kVstParameterUsesIntStep, 7, 7, false},
          Case{kVstParameterUsesFloatStep | kVstParameterCanRamp, 7, 0, true}})
    {
        FakeEffect fake;
        VstParameterProperties properties = {};
        properties.flags = expected.flags;
        properties.stepInteger = expected.stepInteger;
        Describe(fake, properties);
        const auto info = MakeInfo(fake);
        EXPECT_EQ(info->GetStepCount(), expected.steps) << expected.flags;
        EXPECT_EQ(info->CanRamp(), expected.ramps) << expected.flags;
    }
}

TEST(VSTParameterInfo, PropertiesThatAreRefusedDoNotCount)
{
    FakeEffect fake;
    fake.Text(effGetParamLabel, "ms");
    fake.On(effGetParameterProperties,
            [](int, long long, void* ptr, float)
            {
                std::memset(ptr, 0xff, sizeof(VstParameterProperties));
                return 0LL;
            });
    const auto info = MakeInfo(fake);
    EXPECT_TRUE(info->GetLabel() == u"ms");
    EXPECT_EQ(info->GetStepCount(), 0);
    EXPECT_FALSE(info->CanRamp());
    EXPECT_EQ(info->FromNormalized(0.25F), 0.25F);
}

TEST(VSTParameterInfo, TextIsThatOfTheCurrentValue)
{
    FakeEffect fake;
    const auto info = MakeInfo(fake);
    fake.Text(effGetParamDisplay, "-6.0 \xe2\x88\x9e");
    EXPECT_TRUE(info->GetParameterString(0.9F) == u"-6.0 \u221e");
    EXPECT_EQ(fake.CallsTo("effGetParamDisplay").at(0).index, 3);
    EXPECT_FALSE(info->SupportsStringForArbitraryValues());
    EXPECT_EQ(fake.Count("setParameter"), 0U);
}

TEST(VSTParameterInfo, AutomationIsThePluginsAnswer)
{
    FakeEffect fake;
    const auto info = MakeInfo(fake);
    EXPECT_FALSE(info->CanBeAutomated());
    fake.Return(effCanBeAutomated, 1);
    EXPECT_TRUE(info->CanBeAutomated());
    EXPECT_EQ(fake.CallsTo("effCanBeAutomated").at(0).index, 3);
}

TEST(VSTParameterInfo, ThrowingPluginHasNothingToTell)
{
    FakeEffect fake;
    for (const AEffectOpcodes opcode :
         {effGetParamName, effGetParamLabel, effGetParameterProperties, effGetParamDisplay, effCanBeAutomated})
        fake.Throw(opcode);
    const auto info = MakeInfo(fake);
    EXPECT_TRUE(info->GetName().empty());
    EXPECT_TRUE(info->GetLabel().empty());
    EXPECT_TRUE(info->GetParameterString(0.0F).empty());
    EXPECT_FALSE(info->CanRamp());
    EXPECT_FALSE(info->CanBeAutomated());
}

TEST(VSTParameterInfo, NoPluginIsAViolation)
{
    try
    {
        const VSTParameterInfo info(nullptr, 0);
        FAIL();
    }
    catch (const zebcore::config::Error& error)
    {
        EXPECT_TRUE(error.GetMessageText() == u"An input contract violation has occurred!");
    }
}

} // namespace

} // namespace zebaudiofilterhost::vst
