#include "foundation/zebcore/NumberToString.h"

#include "tests/foundation/ForeignLocale.h"

#include <gtest/gtest.h>

#include <limits>

using namespace zebcore;
using namespace zebcore::utility;

namespace
{

UTF16String Text(double value, unsigned long decimals)
{
    return NumberToString(value, 3, decimals, Flags<unsigned short>(), 31);
}

TEST(NumberToString, WritesTheGivenDecimals)
{
    struct Case
    {
        double mValue;
        unsigned long mDecimals;
        UTF16String mText;
    };
    const Case cases[] = {
        {0.0, 0, u"0"},          {0.05, 4, u"0.0500"},     {-12.345, 1, u"-12.3"},
        {99.96, 1, u"100.0"},    {20000.0, 0, u"20000"},   {1e15, 2, u"1000000000000000.00"},
        {0.00001, 4, u"0.0000"}, {-0.00001, 4, u"0.0000"}, {-0.0, 0, u"0"},
        {-0.6, 0, u"-1"},
    };
    for (const Case& number : cases)
        EXPECT_TRUE(Text(number.mValue, number.mDecimals) == number.mText) << number.mValue;
}

TEST(NumberToString, PrintsWhatIsNoNumber)
{
    EXPECT_TRUE(Text(std::numeric_limits<double>::infinity(), 2) == u"inf");
    EXPECT_TRUE(Text(-std::numeric_limits<double>::infinity(), 2) == u"-inf");
    EXPECT_TRUE(Text(std::numeric_limits<double>::quiet_NaN(), 2) == u"nan");
    EXPECT_TRUE(Text(-std::numeric_limits<double>::quiet_NaN(), 2) == u"nan");
}

TEST(NumberToString, BearsExtremes)
{
    const UTF16String largest = Text(-std::numeric_limits<double>::max(), std::numeric_limits<unsigned long>::max());
    EXPECT_EQ(1U + 309U + 1U + 100U, largest.size());
    EXPECT_TRUE(largest.starts_with(u"-17976931348623157"));
}

TEST(NumberToString, IgnoresTheGlobalLocale)
{
    const ForeignLocale foreign;
    EXPECT_TRUE(Text(1234.5, 1) == u"1234.5");
}

} // namespace
