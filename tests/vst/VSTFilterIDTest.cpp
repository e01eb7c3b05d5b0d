#include "host/src/VST/src/VSTFilterID.h"

#include "host/VST/VSTTechnology.h"

#include <gtest/gtest.h>

namespace zebaudiofilterhost::vst
{

namespace
{

TEST(VSTFilterID, NumberAndFileTitle)
{
    struct Case
    {
        unsigned int mUniqueID;
        const char16_t* mPath;
        const char16_t* mText;
    };
    const Case cases[] = {
        {1517179725, u"/usr/lib/vst/PlainFinisher.vst", u"2:1517179725 PlainFinisher"},
        {0xffffffff, u"/a b/My Effect-vst.so", u"2:4294967295 My Effect-vst"},
        {0, u"two.dots.so", u"2:0 two.dots"},
        {7, u"", u"2:7 "},
    };
    for (const Case& test : cases)
    {
        EXPECT_TRUE(EncodeFilterID(test.mUniqueID, test.mPath) == test.mText) << test.mUniqueID;
        unsigned int decoded = 99;
        DecodeFilterID(test.mText, decoded);
        EXPECT_EQ(decoded, test.mUniqueID);
    }
}

TEST(VSTFilterID, DecodingReadsTheNumberOnly)
{
    constexpr unsigned int kOld = 99;
    struct Case
    {
        const char16_t* mText;
        unsigned int mUniqueID;
    };
    const Case cases[] = {
        {u"1517179725 PlainFinisher", 1517179725},
        {u"2:1517179725 PlainFinisher", 1517179725},
        {u"x:5 Title", 5}, // the technology is not looked at
        {u"2: 5", 5},
        {u"12", 12},
        {u"2:5Title", 5},
        {u"2:", 2}, // too short to have a prefix
        {u"2:4294967295 a", 4294967295},
        {u"2:4294967296 a", kOld},
        {u"2:Title", kOld},
        {u"", kOld},
        {u"\xd800:\xdc00 1", kOld},
    };
    int place = 0;
    for (const Case& test : cases)
    {
        unsigned int decoded = kOld;
        DecodeFilterID(test.mText, decoded);
        EXPECT_EQ(decoded, test.mUniqueID) << "case " << place;
        ++place;
    }
}

TEST(VSTFilterID, FactoryGuid)
{
    EXPECT_TRUE(GetVSTFactoryGuid().AsString() == u"e84e3bdd-b4e2-416c-8b6d-5c0dd76d197f");
}

} // namespace

} // namespace zebaudiofilterhost::vst
