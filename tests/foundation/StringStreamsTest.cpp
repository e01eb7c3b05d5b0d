#include "foundation/zebcore/StringStreams.h"

#include "tests/foundation/ForeignLocale.h"

#include <gtest/gtest.h>

#include <iomanip>
#include <limits>

using namespace zebcore;
using namespace zebcore::utility;

namespace
{

template <class... Values>
UTF16String Written(const Values&... values)
{
    oUTF16StringStream stream;
    (stream << ... << values);
    return stream.str();
}

TEST(OutputStringStream, WritesIntegersInDecimal)
{
    EXPECT_TRUE(Written(0, u' ', -1, u' ', 4294967295U) == u"0 -1 4294967295");
    EXPECT_TRUE(Written(std::numeric_limits<long long>::min()) == u"-9223372036854775808");
    EXPECT_TRUE(Written(std::numeric_limits<unsigned long long>::max()) == u"18446744073709551615");
}

TEST(OutputStringStream, WritesFloatsWithSixDigits)
{
    EXPECT_TRUE(Written(0.5F) == u"0.5");
    EXPECT_TRUE(Written(1.0F / 3.0F) == u"0.333333");
    EXPECT_TRUE(Written(1e-7) == u"1e-07");
    EXPECT_TRUE(Written(1234567.0) == u"1.23457e+06");
    EXPECT_TRUE(Written(std::showpoint, std::setprecision(8), 0.5F) == u"0.50000000");
}

TEST(OutputStringStream, WidthHoldsForOneOutput)
{
    EXPECT_TRUE(Written(std::hex, std::setfill('0'), std::setw(8), 0x12ab34, u' ', 5, u' ', 0xff00) ==
                u"0012ab34 5 ff00");
    EXPECT_TRUE(Written(std::setw(4), u"ab", u"cd") == u"  abcd");
    EXPECT_TRUE(Written(std::left, std::setw(4), u8"ab", std::setw(2), "cde", u'|') == u"ab  cde|");
}

TEST(OutputStringStream, TakesTextOfEveryKind)
{
    const UTF16String wide = u"\u00e9\U0001F3B9";
    const UTF8String narrow = u8"\u00e9\U0001F3B9";
    EXPECT_TRUE(Written(wide, narrow, "abc", 'd', u'e', u8"f", std::string("g")) == wide + wide + u"abcdefg");
    EXPECT_TRUE(Written(static_cast<const char16_t*>(nullptr), static_cast<const char*>(nullptr), 1) == u"1");

    oUTF8StringStream stream;
    stream << wide << narrow << "abc" << u'd' << u8"\u00e9" << reinterpret_cast<const unsigned char*>("f") << 7;
    EXPECT_TRUE(stream.str() == narrow + narrow + u8"abcd\u00e9f7");
}

TEST(OutputStringStream, KeepsZeroUnitsAndLoneSurrogates)
{
    const UTF16String padded{u'a', u'\0', char16_t(0xD800), u'\0'};
    EXPECT_TRUE(Written(padded, 1) == padded + u"1");
}

TEST(OutputStringStream, GoesOnAfterNullNarrowText)
{
    char* none = nullptr;
    EXPECT_TRUE(Written(none, 1, u'x') == u"1x");
}

TEST(OutputStringStream, IgnoresTheGlobalLocale)
{
    const ForeignLocale foreign;
    EXPECT_TRUE(Written(1234567, u' ', 0.5) == u"1234567 0.5");
}

TEST(ConsoleStream, HandsEachOutputToItsOwner)
{
    class Console : public UTF16OutputStream
    {
    public:
        void flush() override { ++mFlushes; }

        UTF16String mText;
        int mFlushes = 0;

    protected:
        void Write(std::u16string_view text) override { mText += text; }
    };

    Console console;
    UTF16OutputStream& output = console;
    output << u"Done." << '\n';
    output.flush();
    EXPECT_TRUE(console.mText == u"Done.\n");
    EXPECT_EQ(1, console.mFlushes);
}

TEST(InputStringStream, ReadsAsTheStandardStreamsDo)
{
    struct Case
    {
        UTF16String mText;
        bool mReads;
        long mValue;
    };
    const Case cases[] = {
        {u"3", true, 3},
        {u" \t\n-17:rest", true, -17},
        {u"+5", true, 5},
        {u"12\u0660", true, 12},
        {UTF16String(u"12\0003", 4), true, 12},
        {u"007", true, 7},
        {u"", false, 0},
        {u"  ", false, 0},
        {u"abc", false, 0},
        {u"-", false, 0},
        {u"\uFF13", false, 0},
        {u"99999999999999999999", false, 0},
    };
    for (const Case& text : cases)
    {
        iUTF16StringStream stream(text.mText);
        long value = 0;
        stream >> value;
        EXPECT_EQ(text.mReads, !stream.fail());
        EXPECT_EQ(text.mReads, static_cast<bool>(stream));
        if (text.mReads)
        {
            EXPECT_EQ(text.mValue, value);
        }
    }
}

TEST(InputStringStream, ReadsHexadecimalWords)
{
    iUTF16StringStream stream(u"0012ab34 5 FF00 ffffffff tail");
    unsigned int words[4] = {};
    stream >> std::hex >> words[0] >> words[1] >> words[2] >> words[3];
    EXPECT_FALSE(!stream);
    EXPECT_EQ(0x0012ab34U, words[0]);
    EXPECT_EQ(5U, words[1]);
    EXPECT_EQ(0xff00U, words[2]);
    EXPECT_EQ(0xffffffffU, words[3]);
}

TEST(InputStringStream, StaysFailed)
{
    iUTF16StringStream stream(u"1 x 2");
    int first = 0;
    int second = 0;
    int third = 7;
    stream >> first >> second >> third;
    EXPECT_TRUE(stream.fail());
    EXPECT_EQ(1, first);
    EXPECT_EQ(7, third);
}

TEST(InputStringStream, IgnoresTheGlobalLocale)
{
    const ForeignLocale foreign;
    iUTF16StringStream stream(u"1.234");
    int value = 0;
    stream >> value;
    EXPECT_EQ(1, value);
}

} // namespace
