#include "host/src/VST/src/VSTEffectText.h"

#include "tests/vst/support/FakeEffect.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <stdexcept>

namespace zebaudiofilterhost::vst
{

namespace
{

using fakeeffect::FakeEffect;

TEST(VSTEffectText, EachQuestionHasItsOpcode)
{
    FakeEffect fake;
    fake.Text(effGetEffectName, "Reverb \xc3\xa4");
    fake.Text(effGetVendorString, "Maker");
    fake.Text(effGetProductString, "Suite");
    EXPECT_TRUE(GetEffectName(fake.Get()) == u"Reverb \u00e4");
    EXPECT_TRUE(GetVendorString(fake.Get()) == u"Maker");
    EXPECT_TRUE(GetProductString(fake.Get()) == u"Suite");
    for (const fakeeffect::Call& call : fake.Calls())
    {
        EXPECT_EQ(call.index, 0);
        EXPECT_EQ(call.value, 0);
        EXPECT_EQ(call.opt, 0.0F);
    }
}

TEST(VSTEffectText, NobodyAnswersWithoutADispatcher)
{
    FakeEffect fake;
    fake.effect.dispatcher = nullptr;
    for (const auto ask : {GetEffectName, GetVendorString, GetProductString})
    {
        EXPECT_TRUE(ask(fake.Get()).empty());
        EXPECT_TRUE(ask(nullptr).empty());
    }
}

TEST(VSTEffectText, TheBufferIsLongAndEmpty)
{
    FakeEffect fake;
    bool wasEmpty = false;
    fake.On(effGetEffectName,
            [&wasEmpty](int, long long, void* ptr, float)
            {
                char* text = static_cast<char*>(ptr);
                wasEmpty = std::all_of(text, text + 256, [](char unit) { return unit == 0; });
                std::memset(text, 'x', 256); // no terminator
                return 1LL;
            });
    EXPECT_TRUE(GetEffectName(fake.Get()) == UTF16String(256, u'x'));
    EXPECT_TRUE(wasEmpty);
}

TEST(VSTEffectText, WhatIsNoTextIsEmptyOrReplaced)
{
    FakeEffect fake;
    EXPECT_TRUE(GetEffectName(fake.Get()).empty()) << "no answer";
    fake.Text(effGetVendorString, "");
    EXPECT_TRUE(GetVendorString(fake.Get()).empty());
    fake.Text(effGetVendorString, "a\xe4");
    EXPECT_TRUE(GetVendorString(fake.Get()) == u"a\ufffd") << "no UTF-8";
    fake.On(effGetProductString,
            [](int, long long, void* ptr, float) -> long long
            {
                std::strcpy(static_cast<char*>(ptr), "half");
                throw std::runtime_error("no");
            });
    EXPECT_TRUE(GetProductString(fake.Get()).empty());
}

} // namespace

} // namespace zebaudiofilterhost::vst
