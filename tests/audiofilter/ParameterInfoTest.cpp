#include "audiofilter/GenericParameterInfo.h"

#include "foundation/zebcore/StringConversion.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace zebaudiofilterhost
{
namespace
{

boost::intrusive_ptr<GenericParameterInfo> MakeInfo(int unit, float lo, float hi, bool logarithmic = false,
                                                    bool canBeAutomated = true)
{
    return new GenericParameterInfo(u"Gain", u"dB", static_cast<AudioFilterParameterInfoUnit>(unit), 0, lo, hi,
                                    canBeAutomated, logarithmic, 1, 6);
}

// The text at normalised 0, which is the lo bound whatever the range.
std::string TextOf(int unit, float value)
{
    return zebcore::utility::NarrowFromUTF16(MakeInfo(unit, value, value + 1.0F)->GetParameterString(0.0F));
}

TEST(GenericParameterInfo, DecimalsFollowTheMagnitude)
{
    const std::vector<std::pair<float, std::string>> cases{
        {101.5F, "102"},     {100.0F, "100.0"}, {99.75F, "99.8"},  {10.0F, "10.00"},
        {9.5F, "9.50"},      {1.0F, "1.000"},   {0.5F, "0.500"},   {0.1F, "0.1000"},
        {0.0625F, "0.0625"}, {0.0F, "0.0000"},  {-1.0F, "-1.000"}, {-100.5F, "-100"},
    };
    for (const int unit : {0, 1, 2, 4, 5})
    {
        for (const auto& [value, text] : cases)
            EXPECT_EQ(TextOf(unit, value), text) << value;
    }
}

TEST(GenericParameterInfo, OnOffLooksAtTheNormalisedValue)
{
    const auto info = MakeInfo(3, -100.0F, -50.0F);
    EXPECT_TRUE(info->GetParameterString(0.5F) == u"On");
    EXPECT_TRUE(info->GetParameterString(std::nextafter(0.5F, 0.0F)) == u"Off");
}

TEST(GenericParameterInfo, IntegersTruncateTowardZeroAndNeverOverflow)
{
    const std::vector<std::pair<float, std::string>> cases{
        {-1.9F, "-1"},          {1.9F, "1"},
        {-0.5F, "0"},           {4e9F, "2147483647"},
        {-4e9F, "-2147483648"}, {std::numeric_limits<float>::quiet_NaN(), "0"},
    };
    for (const auto& [value, text] : cases)
        EXPECT_EQ(TextOf(6, value), text);
}

TEST(GenericParameterInfo, UnknownUnitsPrintNothing)
{
    for (const int unit : {7, 1000, -1})
        EXPECT_EQ(TextOf(unit, 1.0F), "");
}

TEST(GenericParameterInfo, LinearAndLogarithmicRangesGoBothWays)
{
    const auto identity = MakeInfo(0, 0.0F, 1.0F);
    EXPECT_EQ(identity->ToNormalized(0.3F), 0.3F);
    EXPECT_EQ(identity->FromNormalized(0.3F), 0.3F);
    const auto decibels = MakeInfo(0, -60.0F, 12.0F);
    EXPECT_EQ(decibels->FromNormalized(0.5F), -24.0F);
    EXPECT_EQ(decibels->ToNormalized(-24.0F), 0.5F);
    const auto hertz = MakeInfo(0, 20.0F, std::log(1000.0F), true);
    EXPECT_NEAR(hertz->FromNormalized(1.0F), 20000.0F, 0.05F);
    EXPECT_NEAR(hertz->ToNormalized(20000.0F), 1.0F, 1e-6F);
    EXPECT_EQ(hertz->FromNormalized(0.0F), 20.0F);
    EXPECT_NEAR(hertz->FromNormalized(0.5F), 632.4555F, 0.01F);
}

TEST(GenericParameterInfo, WhatCannotBeAutomatedStartsHidden)
{
    EXPECT_TRUE(MakeInfo(0, 0.0F, 1.0F)->IsExposed());
    const auto hidden = MakeInfo(0, 0.0F, 1.0F, false, false);
    EXPECT_FALSE(hidden->IsExposed());
    EXPECT_FALSE(hidden->CanBeAutomated());
    hidden->SetExposed(true);
    EXPECT_TRUE(hidden->IsExposed());
}

TEST(GenericParameterInfo, TheBaseAnswersTheRest)
{
    const auto info = MakeInfo(0, 0.0F, 1.0F);
    EXPECT_EQ(info->GetStepCount(), 0);
    EXPECT_FALSE(info->CanRamp());
    EXPECT_TRUE(info->SupportsStringForArbitraryValues());
    info->SetHiBound(3.0F);
    info->SetLoBound(1.0F);
    EXPECT_EQ(info->FromNormalized(0.5F), 2.0F);
}

} // namespace
} // namespace zebaudiofilterhost
