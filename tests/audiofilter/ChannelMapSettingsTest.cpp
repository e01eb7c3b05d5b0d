// Channel maps in settings, also in settings that lie.
#include "tests/audiofilter/RecordingFilter.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

namespace zebaudiofilterhost
{
namespace
{

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::MakeBus;
using testing::MakeFilter;
using testing::MakeMap;
using testing::PlugChannels;

constexpr auto kInput = AudioFilter::kDirection_Input;
constexpr auto kOutput = AudioFilter::kDirection_Output;

boost::intrusive_ptr<testing::RecordingFilter> StereoOnFour()
{
    auto filter = MakeFilter({2}, {2});
    filter->SetMainTargetBus(MakeBus(4));
    filter->SetUseChannelMap(true);
    return filter;
}

PropList Section(unsigned int count, const std::vector<std::pair<int, int>>& records)
{
    PropList section;
    section.SetValue(u8"C", count);
    char8_t digit = u8'1';
    for (const auto& [slot, plugChannel] : records)
    {
        section.SetValue(UTF8String(u8"S_") + digit, slot);
        section.SetValue(UTF8String(u8"D_") + digit, plugChannel);
        ++digit;
    }
    return section;
}

PropList Settings(const PropList& inputs, const PropList& outputs)
{
    PropList settings;
    settings.GetOrCreateSubList(u8"InputMapping") = inputs;
    settings.GetOrCreateSubList(u8"OutputMapping") = outputs;
    return settings;
}

TEST(ChannelMapSettings, SavedMapsComeBack)
{
    const auto filter = StereoOnFour();
    filter->SetChannelMap(MakeMap(4, {{1, 0}, {3, 1}}), kInput);
    filter->SetChannelMap(MakeMap(4, {{0, 1}}), kOutput);
    PropList settings;
    ASSERT_TRUE(filter->SaveChannelMapSettings(&settings));

    const auto other = StereoOnFour();
    int fired = 0;
    other->ConnectChannelMapChanged([&fired](auto&&...) { ++fired; });
    ASSERT_TRUE(other->LoadChannelMapSettings(&settings));
    EXPECT_THAT(PlugChannels(other->GetChannelMap(kInput)), ElementsAre(-1, 0, -1, 1));
    EXPECT_THAT(PlugChannels(other->GetChannelMap(kOutput)), ElementsAre(1, -1, -1, -1));
    EXPECT_EQ(fired, 0);
}

TEST(ChannelMapSettings, SavedFormIsOneRecordAConnection)
{
    const auto filter = StereoOnFour();
    ChannelMap map = MakeMap(2, {{1, 0}});
    map.SetChannelLayout(1, {static_cast<AudioChannelLabel>(0), static_cast<AudioChannelLabel>(1)});
    filter->SetChannelMap(map, kInput);
    PropList settings;
    filter->SaveChannelMapSettings(&settings);
    PropList expected = Section(3, {{0, -1}, {1, 0}, {1, 1}});
    const PropList* const saved = settings.GetSubList(u8"InputMapping");
    ASSERT_NE(saved, nullptr);
    for (const char8_t* key : {u8"S_1", u8"D_1", u8"S_2", u8"D_2", u8"S_3", u8"D_3"})
    {
        int value = -2;
        int wanted = -2;
        EXPECT_TRUE(saved->GetValue(key, value) && expected.GetValue(key, wanted));
        EXPECT_EQ(value, wanted);
    }
    unsigned int count = 0;
    EXPECT_TRUE(saved->GetValue(u8"C", count));
    EXPECT_EQ(count, 3U);
}

TEST(ChannelMapSettings, NothingHappensUnlessMapsAreInUse)
{
    const auto filter = StereoOnFour();
    PropList settings;
    filter->SaveChannelMapSettings(&settings);
    filter->SetUseChannelMap(false);
    EXPECT_FALSE(filter->LoadChannelMapSettings(&settings));
    PropList untouched;
    EXPECT_FALSE(filter->SaveChannelMapSettings(&untouched));
    EXPECT_TRUE(untouched.IsEmpty());
}

TEST(ChannelMapSettings, RecordsAreCheckedAgainstTargetAndBuses)
{
    constexpr int kHuge = std::numeric_limits<int>::max();
    struct Case
    {
        unsigned int count;
        std::vector<std::pair<int, int>> records;
        bool loaded;
        std::vector<int> expected; // Of four slots; the map before is empty
    };
    const std::vector<Case> cases{
        {0, {}, true, {0, 1, 2, 3}},                    // Straight over the whole target
        {1, {{2, -1}}, true, {0, 1, -1, 3}},            // Recorded as unconnected
        {2, {{0, 1}, {1, 0}}, true, {1, 0, 2, 3}},      // Swapped
        {1, {{0, 2}}, true, {-1, 1, 2, 3}},             // No bus has a third channel
        {1, {{4, 0}}, true, {0, 1, 2, 3}},              // Beyond the main target: a side chain's channel
        {2, {{-1, 0}, {kHuge, 1}}, true, {0, 1, 2, 3}}, // No slots at all
        {1, {{0, kHuge}}, true, {-1, 1, 2, 3}},
        {1, {{0, -kHuge}}, true, {-1, 1, 2, 3}},
        {2, {{0, 1}}, false, {}},                   // A record is missing
        {4294967295U, {{0, 1}, {1, 0}}, false, {}}, // The count lies
        {1, {{3, 1}, {0, 0}}, true, {0, 1, 2, 1}},  // What the count leaves out is not read
    };
    for (std::size_t i = 0; i < cases.size(); ++i)
    {
        const auto filter = StereoOnFour();
        const PropList section = Section(cases[i].count, cases[i].records);
        const PropList settings = Settings(section, section);
        EXPECT_EQ(filter->LoadChannelMapSettings(&settings), cases[i].loaded) << "case " << i;
        EXPECT_EQ(PlugChannels(filter->GetChannelMap(kInput)), cases[i].expected) << "case " << i;
        EXPECT_EQ(PlugChannels(filter->GetChannelMap(kOutput)), cases[i].expected) << "case " << i;
    }
}

TEST(ChannelMapSettings, EachBusIsTestedByItself)
{
    const auto filter = MakeFilter({2, 2}, {2});
    filter->SetMainTargetBus(MakeBus(2));
    filter->SetUseChannelMap(true);
    const PropList section = Section(2, {{0, 3}, {1, 1}}); // 3 is there in the row, but in no single bus
    const PropList settings = Settings(section, section);
    EXPECT_TRUE(filter->LoadChannelMapSettings(&settings));
    EXPECT_THAT(PlugChannels(filter->GetChannelMap(kInput)), ElementsAre(-1, 1));
}

TEST(ChannelMapSettings, AnInputMapThatLoadedStaysWhenTheOutputMapFails)
{
    const auto filter = StereoOnFour();
    const PropList settings = Settings(Section(0, {}), PropList());
    EXPECT_FALSE(filter->LoadChannelMapSettings(&settings));
    EXPECT_THAT(PlugChannels(filter->GetChannelMap(kInput)), ElementsAre(0, 1, 2, 3));
    EXPECT_THAT(PlugChannels(filter->GetChannelMap(kOutput)), IsEmpty());

    const auto other = StereoOnFour();
    const PropList reversed = Settings(PropList(), Section(0, {}));
    EXPECT_FALSE(other->LoadChannelMapSettings(&reversed));
    EXPECT_THAT(PlugChannels(other->GetChannelMap(kOutput)), IsEmpty());
    EXPECT_FALSE(other->LoadChannelMapSettings(nullptr));
}

} // namespace
} // namespace zebaudiofilterhost
