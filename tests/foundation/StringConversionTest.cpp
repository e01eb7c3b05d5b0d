#include "foundation/zebcore/StringConversion.h"

#include <gtest/gtest.h>

using namespace zebcore;
using namespace zebcore::utility;

namespace
{

TEST(StringConversion, WellFormedTextGoesThereAndBack)
{
    struct Case
    {
        UTF16String mWide;
        UTF8String mNarrow;
    };
    const Case cases[] = {
        {u"", u8""},
        {u"Gain", u8"Gain"},
        {u"\u00e9\u20ac", u8"\u00e9\u20ac"},
        {u"\U0001F3B9!", u8"\U0001F3B9!"},
        {u"\U00010000\U0010FFFF", u8"\U00010000\U0010FFFF"},
        {UTF16String(u"a\0b", 3), UTF8String(u8"a\0b", 3)},
        {u"\uD7FF\uE000\uFFFE\uFFFF", u8"\uD7FF\uE000\uFFFE\uFFFF"},
    };
    for (const Case& text : cases)
    {
        EXPECT_TRUE(UTF16to8(text.mWide) == text.mNarrow);
        EXPECT_TRUE(UTF8to16(text.mNarrow) == text.mWide);
        EXPECT_TRUE(UTF16FromNarrow(NarrowFromUTF16(text.mWide)) == text.mWide);
        EXPECT_TRUE(UTF8FromNarrow(NarrowFromUTF8(text.mNarrow)) == text.mNarrow);
    }
}

TEST(StringConversion, LoneSurrogatesAreReplacedOneByOne)
{
    EXPECT_TRUE(UTF16to8(UTF16String{u'a', char16_t(0xD800), u'b'}) == u8"a\uFFFDb");
    EXPECT_TRUE(UTF16to8(UTF16String{u'a', char16_t(0xDC00)}) == u8"a\uFFFD");
    EXPECT_TRUE(UTF16to8(UTF16String{char16_t(0xD83C)}) == u8"\uFFFD");
    // The second of two high surrogates may still begin a pair.
    EXPECT_TRUE(UTF16to8(UTF16String{char16_t(0xD83C), char16_t(0xD83C), char16_t(0xDFB9)}) == u8"\uFFFD\U0001F3B9");
    EXPECT_TRUE(UTF16to8(UTF16String{char16_t(0xDFB9), char16_t(0xD83C)}) == u8"\uFFFD\uFFFD");
}

TEST(StringConversion, IllFormedBytesAreReplacedAndReported)
{
    struct Case
    {
        const char* mBytes;
        unsigned long mFirst;
    };
    const Case cases[] = {
        {"a\xFFz", 1},            // never a byte of UTF-8
        {"ab\x80z", 2},           // continuation without a start
        {"\xC3", 0},              // cut off
        {"a\xE2\x82", 1},         // cut off
        {"\xC0\x80z", 0},         // overlong zero
        {"\xED\xA0\x80z", 0},     // a surrogate in UTF-8
        {"\xF4\x90\x80\x80z", 0}, // beyond the last code point
    };
    for (const Case& text : cases)
    {
        UnicodeErrorCode error = kUnicodeError_None;
        unsigned long position = 99;
        const UTF16String converted = UTF8to16(UTF8FromNarrow(text.mBytes), &error, &position);
        EXPECT_EQ(kUnicodeError_IllFormed, error);
        EXPECT_EQ(text.mFirst, position);
        EXPECT_EQ(text.mFirst, converted.find(u'\uFFFD'));
        EXPECT_TRUE(UTF16FromNarrow(text.mBytes) == converted);
    }
}

TEST(StringConversion, ReportsThatNothingWasReplaced)
{
    UnicodeErrorCode error = kUnicodeError_IllFormed;
    unsigned long position = 0;
    UTF8to16(u8"\u00e9t\u00e9", &error, &position);
    EXPECT_EQ(kUnicodeError_None, error);
    EXPECT_EQ(5U, position);
}

TEST(StringConversion, AsciiWidensEachByte)
{
    EXPECT_TRUE(AsciiToUTF16("Audio", 3) == u"Aud");
    EXPECT_TRUE(AsciiToUTF16(nullptr, 0).empty());
    EXPECT_TRUE(AsciiToUTF16("\xE9\xFF", 2) == u"\u00e9\u00ff");
    EXPECT_TRUE(AsciiToUTF16("Audio") == u"Audio");
}

} // namespace
