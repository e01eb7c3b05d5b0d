#include "host/PluginLocator.h"

#include "tests/host/CatalogueFixture.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

namespace zebaudiofilterhost::testing
{

TEST(PluginLocator, ParsesWhateverStandsInAFile)
{
    struct Case
    {
        UTF16String text;
        int type;
        UTF16String path;
    };
    constexpr int kLowest = std::numeric_limits<int>::min();
    const std::vector<Case> cases = {
        {u"3:/a/b.vst3", 3, u"/a/b.vst3"},
        {u"3:/a:b:c", 3, u"/a:b:c"},
        {u"0:", 0, u""},
        {u":/a", 0, u"/a"},
        {u"", 0, u""},
        {u"/no/colon", 0, u""},
        {u"vst:/a", 0, u"/a"},
        {u" 3x:/a", 3, u"/a"},
        {u"77:/a", 77, u"/a"},
        {u"-2147483648:/a", kLowest, u"/a"},
        {u"-2147483649:/a", 0, u"/a"},
        {u"2147483648:/a", 0, u"/a"},
        {u"99999999999999999999999:/a", 0, u"/a"},
        {UTF16String(u"3:\0\xd800", 4), 3, UTF16String(u"\0\xd800", 2)},
    };
    for (const Case& expected : cases)
    {
        SCOPED_TRACE(Text(expected.text));
        PluginLocator locator(kTechnologyVST, u"overwritten");
        locator.FromString(expected.text);
        EXPECT_EQ(locator.GetTechnologyType(), expected.type);
        EXPECT_TRUE(locator.GetPath() == expected.path);
        PluginLocator again;
        again.FromString(locator.ToString());
        EXPECT_TRUE(again == locator);
    }
}

TEST(PluginLocator, PrintsTypeColonPath)
{
    EXPECT_EQ(Text(PluginLocator()), "0:");
    EXPECT_EQ(Text(VST3(u"/x/y.vst3")), "3:/x/y.vst3");
    EXPECT_EQ(Text(PluginLocator(static_cast<TechnologyType>(-7), u"p")), "-7:p");
}

TEST(PluginLocator, OrdersByTypeBeforePath)
{
    const std::vector<PluginLocator> ascending = {PluginLocator(static_cast<TechnologyType>(-1), u"/z"),
                                                  PluginLocator(),
                                                  VST2(u"/b"),
                                                  VST3(u"/a"),
                                                  VST3(u"/a/b"),
                                                  VST3(u"/b"),
                                                  AudioUnit(u"/a")};
    for (std::size_t left = 0; left < ascending.size(); ++left)
    {
        for (std::size_t right = 0; right < ascending.size(); ++right)
        {
            SCOPED_TRACE(Text(ascending[left]) + " and " + Text(ascending[right]));
            EXPECT_EQ(ascending[left] < ascending[right], left < right);
            EXPECT_EQ(ascending[left] == ascending[right], left == right);
            EXPECT_EQ(ascending[left] != ascending[right], left != right);
        }
    }
}

TEST(PluginLocator, AssignsAndSwapsBothFields)
{
    PluginLocator a = VST3(u"/a");
    PluginLocator b = VST2(u"/b");
    const PluginLocator& alias = a;
    a = alias;
    EXPECT_EQ(Text(a), "3:/a");
    a.Swap(b);
    EXPECT_EQ(Text(a), "2:/b");
    EXPECT_EQ(Text(b), "3:/a");
    b = a;
    EXPECT_TRUE(a == b);
}

} // namespace zebaudiofilterhost::testing
