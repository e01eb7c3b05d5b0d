#include "foundation/zebcore/BinaryText.h"

#include <gtest/gtest.h>

using namespace zebcore;
using Bytes = std::vector<unsigned char>;

namespace
{

UTF8String Encode(const Bytes& bytes)
{
    UTF8String text = u8"stale";
    EXPECT_TRUE(utility::EncodeBinaryDataToUTF8String(bytes.data(), bytes.size(), text));
    return text;
}

Bytes AllBytes(std::size_t count)
{
    Bytes bytes(count);
    for (std::size_t i = 0; i < count; ++i)
        bytes[i] = static_cast<unsigned char>(i * 37 + 11);
    return bytes;
}

} // namespace

// Presets of earlier builds hold such texts: these must never change.
TEST(BinaryText, EncodingIsFixed)
{
    const std::pair<Bytes, const char8_t*> samples[] = {
        {{}, u8""},
        {{0}, u8"AA=="},
        {{0, 0}, u8"AAA="},
        {{0, 0, 0}, u8"AAAA"},
        {{'f', 'o', 'o', 'b', 'a', 'r'}, u8"Zm9vYmFy"},
        {{0xFB, 0xEF, 0xBE, 0xFF, 0xFF, 0xFF}, u8"++++////"},
        {{0xFF}, u8"/w=="},
    };
    for (const auto& [bytes, text] : samples)
    {
        EXPECT_TRUE(Encode(bytes) == text) << testing::PrintToString(bytes);
        Bytes decoded{1, 2, 3};
        EXPECT_TRUE(utility::DecodeBinaryDataFromUTF8String(text, decoded));
        EXPECT_EQ(decoded, bytes);
    }
}

TEST(BinaryText, EveryLengthComesBack)
{
    for (std::size_t length = 0; length < 600; ++length)
    {
        const Bytes bytes = AllBytes(length);
        Bytes decoded;
        ASSERT_TRUE(utility::DecodeBinaryDataFromUTF8String(Encode(bytes), decoded)) << length;
        ASSERT_EQ(decoded, bytes);
    }
}

TEST(BinaryText, MalformedTextIsRefused)
{
    const char8_t* const malformed[] = {
        u8"A",    u8"AA",       u8"AAA",      u8"AAAAA",    u8"AA=",    u8"A===",  u8"====",
        u8"=",    u8"AA==AAAA", u8"AAA=AAAA", u8"AA=A",     u8"AA==\n", u8" AAAA", u8"AAAA====",
        u8"AB==", u8"AAB=",     u8"AA-_",     u8"AA\u00e9", u8"A*AA",   u8"=AAA",  u8"AAAAA===",
    };
    for (const char8_t* const text : malformed)
    {
        Bytes decoded{1, 2, 3};
        EXPECT_FALSE(utility::DecodeBinaryDataFromUTF8String(text, decoded))
            << testing::PrintToString(Bytes(text, text + UTF8String(text).size()));
        EXPECT_TRUE(decoded.empty());
    }
    Bytes decoded{1};
    EXPECT_FALSE(utility::DecodeBinaryDataFromUTF8String(UTF8String(4, u8'\0'), decoded));
    EXPECT_TRUE(decoded.empty());
}

TEST(BinaryText, NullIsRefusedUnlessEmpty)
{
    UTF8String text = u8"stale";
    EXPECT_FALSE(utility::EncodeBinaryDataToUTF8String(nullptr, 1, text));
    EXPECT_TRUE(text.empty());
    EXPECT_TRUE(utility::EncodeBinaryDataToUTF8String(nullptr, 0, text));
}
