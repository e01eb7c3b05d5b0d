#include "host/src/VST3/src/VST3FilterID.h"

#include "host/VST3/VST3Technology.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

namespace zebaudiofilterhost::vst3
{

namespace
{

std::string Decode(const UTF16String& text)
{
    Steinberg::TUID id;
    std::memset(id, 0x55, sizeof(id));
    DecodeFilterID(text, id);
    return {id, sizeof(id)};
}

std::string Bytes(std::initializer_list<int> bytes)
{
    std::string result;
    for (const int byte : bytes)
        result.push_back(static_cast<char>(byte));
    result.resize(sizeof(Steinberg::TUID), '\0');
    return result;
}

TEST(VST3FilterID, OnlyTheFirstWordIsPadded)
{
    struct Case
    {
        std::string mBytes;
        const char16_t* mText;
    };
    const Case cases[] = {
        {Bytes({1, 2, 3, 4}), u"3:01020304 0 0 0"},
        {Bytes({0, 0x12, 0xab, 0x34, 0, 0, 0, 5, 0, 0, 0xff, 0, 0, 0, 0, 0xa}), u"3:0012ab34 5 ff00 a"},
        {Bytes({}), u"3:00000000 0 0 0"},
        {std::string(16, '\xff'), u"3:ffffffff ffffffff ffffffff ffffffff"},
    };
    for (const Case& test : cases)
    {
        Steinberg::TUID id;
        std::memcpy(id, test.mBytes.data(), sizeof(id));
        EXPECT_TRUE(EncodeFilterID(id) == test.mText);
        EXPECT_EQ(Decode(test.mText), test.mBytes);
    }
}

TEST(VST3FilterID, EveryTextGivesSomeClass)
{
    struct Case
    {
        const char16_t* mText;
        std::string mBytes;
    };
    const std::string oneToFour = Bytes({0, 0, 0, 1, 0, 0, 0, 2, 0, 0, 0, 3, 0, 0, 0, 4});
    const Case cases[] = {
        {u"3:1 2 3 4", oneToFour},
        {u"1 2 3 4", oneToFour},
        {u"x:1 2 3 4", oneToFour}, // the technology is not looked at
        {u"3:  1\t2\n3 4 5", oneToFour},
        {u"3:00000001 2 3 4", oneToFour},
        {u"3:1 2", Bytes({0, 0, 0, 1, 0, 0, 0, 2})},
        {u"3:1 zz 3 4", Bytes({0, 0, 0, 1})},
        {u"3:1ffffffff 2 3 4", Bytes({})}, // no word of 32 bits
        {u"3:", Bytes({0, 0, 0, 3})},      // too short to have a prefix
        {u"", Bytes({})},
        {u"\xd800:\xdc00 1", Bytes({})},
    };
    for (const Case& test : cases)
        EXPECT_EQ(Decode(test.mText), test.mBytes) << testing::PrintToString(std::u16string(test.mText).size());
}

TEST(VST3FilterID, FactoryGuid)
{
    EXPECT_TRUE(GetVST3FactoryGuid().AsString() == u"eb0fed8b-7841-4f2b-a655-d8cddea9f465");
}

} // namespace

} // namespace zebaudiofilterhost::vst3
