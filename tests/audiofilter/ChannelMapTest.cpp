// Routing as the application edits it.
#include "tests/audiofilter/RecordingFilter.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

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

std::vector<int> Inputs(const AudioFilter& filter)
{
    return PlugChannels(filter.GetChannelMap(kInput));
}

TEST(ChannelMaps, AssignTakesThePlugChannelFromItsOldSlot)
{
    const auto filter = MakeFilter({2}, {2});
    filter->SetChannelMap(ChannelMap(2), kInput);
    filter->AssignChannelMapping(kInput, 0, 1);
    const ChannelMap map = filter->GetChannelMap(kInput);
    EXPECT_THAT(PlugChannels(map), ElementsAre(-1, 0));
    EXPECT_LT(map.Find(0), 0);
    EXPECT_EQ(map.Find(1), 1);
}

TEST(ChannelMaps, AssignGrowsTheMapWithUnconnectedSlots)
{
    const auto filter = MakeFilter({2}, {2});
    filter->AssignChannelMapping(kOutput, 1, 3);
    const ChannelMap map = filter->GetChannelMap(kOutput);
    EXPECT_THAT(PlugChannels(map), ElementsAre(-1, -1, -1, 1));
    EXPECT_LT(map.Find(2), 0);
    EXPECT_THAT(Inputs(*filter), IsEmpty());
}

TEST(ChannelMaps, ANegativePlugChannelEmptiesTheSlotAndKeepsItsSource)
{
    const auto filter = MakeFilter({2}, {2});
    filter->SetChannelMap(ChannelMap(2), kInput);
    filter->AssignChannelMapping(kInput, -1, 1);
    const ChannelMap map = filter->GetChannelMap(kInput);
    EXPECT_THAT(PlugChannels(map), ElementsAre(0, -1));
    EXPECT_LT(map.GetSourceChannelIndexForChannelLabel(static_cast<AudioChannelLabel>(1)), 0);
    EXPECT_EQ(map.Find(1), 1);
}

TEST(ChannelMaps, SlotsThatCannotBeAreIgnored)
{
    const auto filter = MakeFilter({2}, {2});
    filter->SetChannelMap(ChannelMap(2), kInput);
    filter->AssignChannelMapping(kInput, -1, 7);
    filter->AssignChannelMapping(kInput, -1, -7);
    filter->AssignChannelMapping(kInput, 0, -1);
    EXPECT_TRUE(filter->GetChannelMap(kInput) == ChannelMap(2));
}

TEST(ChannelMaps, EverySetterFiresWithOldAndNewMap)
{
    const auto filter = MakeFilter({2}, {2});
    struct Event
    {
        AudioFilter::Direction direction;
        std::vector<int> before;
        std::vector<int> after;
    };
    std::vector<Event> events;
    filter->ConnectChannelMapChanged(
        [&](AudioFilter::Direction direction, const ChannelMap& before, const ChannelMap& after)
        {
            events.push_back({direction, PlugChannels(before), PlugChannels(after)});
            filter->GetChannelMap(direction); // A slot may call back
        });
    filter->SetChannelMap(ChannelMap(1), kOutput);
    filter->AssignChannelMapping(kOutput, 1, 0);
    filter->RemoveChannelMapping(kOutput, 5); // Held by no slot
    filter->RemoveChannelMapping(kOutput, 1);
    filter->SetDefaultChannelMap(kOutput);
    ASSERT_EQ(events.size(), 4U);
    EXPECT_EQ(events[0].direction, kOutput);
    EXPECT_THAT(events[0].before, IsEmpty());
    EXPECT_THAT(events[0].after, ElementsAre(0));
    EXPECT_THAT(events[1].after, ElementsAre(1));
    EXPECT_EQ(events[2].before, events[2].after);
    EXPECT_THAT(events[3].after, ElementsAre(-1));
}

TEST(ChannelMaps, DefaultMapReachesAsFarAsPlugInAndTargetsBoth)
{
    struct Case
    {
        int plugIn;
        int main;
        int sideChain;
        std::size_t inputs;
        std::size_t outputs;
    };
    for (const Case& c : {Case{2, 6, 0, 2, 2}, Case{6, 2, 0, 2, 2}, Case{3, 2, 1, 3, 2}, Case{0, 2, 2, 0, 0}})
    {
        const auto filter = MakeFilter({c.plugIn}, {c.plugIn});
        filter->SetMainTargetBus(MakeBus(c.main));
        filter->SetSideChainTargetBus(MakeBus(c.sideChain));
        filter->SetDefaultChannelMap(kInput);
        filter->SetDefaultChannelMap(kOutput);
        EXPECT_EQ(Inputs(*filter).size(), c.inputs);
        EXPECT_EQ(PlugChannels(filter->GetChannelMap(kOutput)).size(), c.outputs);
        EXPECT_EQ(filter->IsChannelMapDefault(kInput), c.inputs == static_cast<std::size_t>(c.plugIn));
    }
}

TEST(ChannelMaps, BestFitGoesByLabelThenByPosition)
{
    using enum zebmediatypes::AudioChannelLabel;
    const ChannelLayout surround = zebmediatypes::CreateBroadcast51ChannelLayout();
    struct Case
    {
        std::vector<ChannelLayout> buses;
        ChannelLayout target;
        std::vector<int> expected;
    };
    const std::vector<Case> cases{
        {{}, surround, {}},
        {{{}}, surround, {}},
        {{{kAudioChannelLabel_Left, kAudioChannelLabel_Right}}, surround, {0, 1}},
        {{{kAudioChannelLabel_LeftSurround, kAudioChannelLabel_Center}}, surround, {-1, -1, 1, -1, 0}},
        {{{kAudioChannelLabel_Right, kAudioChannelLabel_TopCenter}}, surround, {-1, 0}},
        // Two of a label take the first and the second of it.
        {{{kAudioChannelLabel_Left, kAudioChannelLabel_Left}},
         {kAudioChannelLabel_Left, kAudioChannelLabel_Right, kAudioChannelLabel_Left},
         {0, -1, 1}},
        // Nothing in common: by position, whatever the target's length.
        {{{kAudioChannelLabel_AmbisonicW, kAudioChannelLabel_AmbisonicX}}, {kAudioChannelLabel_Left}, {0, 1}},
        // Only the first bus counts.
        {{{kAudioChannelLabel_Right}, {kAudioChannelLabel_Left}}, surround, {-1, 0}},
    };
    for (std::size_t i = 0; i < cases.size(); ++i)
    {
        std::vector<AudioFilterBusDescription> buses;
        for (const ChannelLayout& layout : cases[i].buses)
            buses.emplace_back(u"", layout, AudioFilterBusDescription::kBusType_Main);
        EXPECT_EQ(PlugChannels(AudioFilter::BuildBestFitChannelMap(buses, cases[i].target)), cases[i].expected)
            << "case " << i;
    }
}

TEST(ChannelMaps, SideChainChannelsGetTheFreeInputs)
{
    struct Case
    {
        std::vector<int> inputs;
        int outputs;
        int sideChain;
        std::vector<int> connected; // Main slots that are connected straight
        std::vector<int> expected;
    };
    const std::vector<Case> cases{
        // The second of two buses is the side chain.
        {{2, 1}, 2, 1, {0, 1}, {0, 1, 2}},
        {{2, 2}, 2, 2, {0, 1}, {0, 1, 2, 3}},
        // One bus: inputs beyond the outputs.
        {{3}, 2, 1, {0, 1}, {0, 1, 2}},
        // As many outputs as inputs: the first input that no slot has as its source.
        {{2}, 2, 1, {0}, {0, -1, 1}},
        // Nothing free, and nowhere to start.
        {{2}, 2, 1, {0, 1}, {0, 1}},
        {{2, 0}, 2, 1, {0, 1}, {0, 1}},
        // Three buses count by outputs.
        {{1, 1, 1}, 1, 1, {0}, {0, -1, 1}},
    };
    for (std::size_t i = 0; i < cases.size(); ++i)
    {
        const Case& c = cases[i];
        const auto filter = MakeFilter(c.inputs, {c.outputs});
        filter->SetMainTargetBus(MakeBus(2));
        filter->SetSideChainTargetBus(MakeBus(c.sideChain));
        for (const int slot : c.connected)
            filter->AssignChannelMapping(kInput, slot, slot);
        int fired = 0;
        filter->ConnectChannelMapChanged([&fired](auto&&...) { ++fired; });
        filter->AutoConnectSideChainChannels(false);
        EXPECT_EQ(Inputs(*filter), c.expected) << "case " << i;
        EXPECT_EQ(fired, 1);
    }
}

TEST(ChannelMaps, SideChainClearsWhatCarriesItsNumbersFirst)
{
    const auto filter = MakeFilter({2, 1}, {2});
    filter->SetMainTargetBus(MakeBus(2));
    filter->SetSideChainTargetBus(MakeBus(1));
    filter->SetChannelMap(MakeMap(2, {{0, 0}, {1, 2}}), kInput); // Slot 1 carries 2, the side chain's number
    filter->AutoConnectSideChainChannels(true);
    EXPECT_THAT(Inputs(*filter), ElementsAre(0, -1, 2));
}

} // namespace
} // namespace zebaudiofilterhost
