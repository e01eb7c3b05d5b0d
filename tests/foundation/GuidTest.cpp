#include "foundation/zebcore/Guid.h"

#include <gtest/gtest.h>

#include <set>

using namespace zebcore;
using zebcore::utility::Guid;

namespace
{

constexpr Guid kSample(0xeb0fed8b, 0x7841, 0x4f2b, 0xa6, 0x55, 0xd8, 0xcd, 0xde, 0xa9, 0xf4, 0x65);

TEST(Guid, TextHasTheCanonicalForm)
{
    EXPECT_TRUE(kSample.AsString() == u"eb0fed8b-7841-4f2b-a655-d8cddea9f465");
    EXPECT_TRUE(Guid().AsString() == u"00000000-0000-0000-0000-000000000000");
    EXPECT_TRUE(Guid(1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11).AsString() == u"00000001-0002-0003-0405-060708090a0b");
}

TEST(Guid, TextIsReadBack)
{
    EXPECT_TRUE(Guid::StringToGUID(kSample.AsString()) == kSample);
    EXPECT_TRUE(Guid::StringToGUID(u"EB0FED8B-7841-4F2B-A655-D8CDDEA9F465") == kSample);
}

TEST(Guid, AnyOtherTextIsAllZero)
{
    const UTF16String texts[] = {
        u"",
        u"eb0fed8b",
        u"eb0fed8b-7841-4f2b-a655-d8cddea9f46",
        u"eb0fed8b-7841-4f2b-a655-d8cddea9f4655",
        u"eb0fed8b-7841-4f2b-a655-d8cddea9f46g",
        u"eb0fed8b+7841-4f2b-a655-d8cddea9f465",
        u"{eb0fed8b-7841-4f2b-a655-d8cddea9f465}",
        u"-b0fed8b-7841-4f2b-a655-d8cddea9f465",
    };
    for (const UTF16String& text : texts)
        EXPECT_TRUE(Guid::StringToGUID(text) == Guid());
}

TEST(Guid, UniqueOnesDiffer)
{
    std::set<Guid> guids;
    for (int i = 0; i < 100; ++i)
        guids.insert(Guid::CreateUnique());
    EXPECT_EQ(100U, guids.size());
    for (const Guid& guid : guids)
        EXPECT_TRUE(Guid::StringToGUID(guid.AsString()) == guid);
}

TEST(Guid, EveryFieldCountsInTheOrder)
{
    EXPECT_TRUE(Guid() < Guid(0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 1));
    EXPECT_TRUE(Guid(0, 0, 1, 0, 0, 0, 0, 0, 0, 0, 0) < Guid(0, 1, 0, 0, 0, 0, 0, 0, 0, 0, 0));
    EXPECT_TRUE(Guid(0, 1, 0, 0, 0, 0, 0, 0, 0, 0, 0) < Guid(1, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0));
    EXPECT_FALSE(kSample < kSample);
}

} // namespace
