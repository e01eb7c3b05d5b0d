#include "host/src/VST3/src/IndexWalk.h"

#include <gtest/gtest.h>

using namespace zebaudiofilterhost::vst3;

namespace
{

// A list of `real` items of which the host is told another count.
int Walk(int told, int real, int* visits = nullptr)
{
    int count = 0;
    const int length = WalkList([told] { return told; },
                                [&](int index)
                                {
                                    ++count;
                                    return index < real ? IndexWalk::kFound : IndexWalk::kMissing;
                                });
    if (visits)
        *visits = count;
    return length;
}

} // namespace

TEST(IndexWalk, TrueCountsAreWalkedWhole)
{
    EXPECT_EQ(Walk(3, 3), 3);
    EXPECT_EQ(Walk(5000, 5000), 5000);
    EXPECT_EQ(Walk(0, 3), 0);
    EXPECT_EQ(Walk(-1, 3), 0);
    EXPECT_EQ(Walk(10, 3), 10); // a few that fail are part of the list
}

TEST(IndexWalk, LyingCountsEndWhereTheListDoes)
{
    int visits = 0;
    EXPECT_EQ(Walk(2147483647, 3, &visits), 3);
    EXPECT_LE(visits, 2000);
    EXPECT_EQ(Walk(2147483647, 2147483647, &visits), kMaxListLength);
    EXPECT_EQ(visits, kMaxListLength);
}

TEST(IndexWalk, StopsWhenToldAndAsksForTheCountAnew)
{
    EXPECT_EQ(
        WalkList([] { return 10; }, [](int index) { return index == 4 ? IndexWalk::kStop : IndexWalk::kFound; }), 5);
    int count = 3;
    EXPECT_EQ(WalkList([&] { return count--; }, [](int) { return IndexWalk::kFound; }), 2);
}
