#include "foundation/zebmediatypes/ChannelMap.h"

#include <gtest/gtest.h>

using namespace zebmediatypes;

namespace
{

AudioChannelLabel Label(int number)
{
    return static_cast<AudioChannelLabel>(number);
}

TEST(ChannelMap, OfACountIsTheIdentity)
{
    ChannelMap built;
    for (int i = 0; i < 3; ++i)
    {
        built.AddChannel({}, i);
        built.SetChannelLayout(i, {Label(i)});
        built.SetChannel(i, i);
    }
    EXPECT_TRUE(ChannelMap(3) == built);
    EXPECT_FALSE(ChannelMap(2) == built);
    EXPECT_TRUE(ChannelMap(0) == ChannelMap());
    EXPECT_TRUE(ChannelMap(-1) == ChannelMap());
}

TEST(ChannelMap, EqualityNeedsLayoutsAndSources)
{
    ChannelMap map(2);
    const ChannelMap copy(map);
    map.SetChannel(1, -1);
    EXPECT_FALSE(map == copy);
    map.SetChannel(1, 1);
    EXPECT_TRUE(map == copy);
    map.SetChannelLayout(1, {});
    EXPECT_FALSE(map == copy);
}

TEST(ChannelMap, SourcesAndLabelsAreTwoNumberSpaces)
{
    ChannelMap map;
    map.AddChannel({Label(5)}, 1);
    map.AddChannel({Label(0), Label(6)}, 0);
    map.AddChannel({Label(5)}, 2);
    EXPECT_EQ(0, map.Find(1));
    EXPECT_EQ(1, map.Find(0));
    EXPECT_LT(map.Find(5), 0);
    EXPECT_EQ(1, map.GetSourceChannelIndexForChannelLabel(Label(5))) << "the first slot that carries it";
    EXPECT_EQ(0, map.GetSourceChannelIndexForChannelLabel(Label(6)));
    EXPECT_LT(map.GetSourceChannelIndexForChannelLabel(Label(1)), 0);
}

TEST(ChannelMap, ADisconnectedSlotIsNoSource)
{
    ChannelMap map(2);
    map.SetChannel(0, -1);
    EXPECT_LT(map.Find(0), 0);
    EXPECT_LT(map.Find(-1), 0) << "nothing is connected to nothing";
    EXPECT_LT(map.GetSourceChannelIndexForChannelLabel(Label(0)), 0);
}

TEST(ChannelMap, SlotsOutsideAreIgnored)
{
    ChannelMap map(1);
    for (const int slot : {-1, 1, 2147483647})
    {
        map.SetChannel(slot, 0);
        map.SetChannelLayout(slot, {Label(9)});
        EXPECT_TRUE(map.GetChannelLayout(slot).empty());
    }
    EXPECT_TRUE(map == ChannelMap(1));
}

} // namespace
