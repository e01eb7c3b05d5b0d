// Parameters and factory presets of a VST 3 filter.

#include "tests/vst3/FakePlugin.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <utility>
#include <vector>

using namespace fakeplugin;
using testing::ElementsAre;
using zebaudiofilterhost::UTF16String;
using zebaudiofilterhost::vst3::VST3AudioFilter;

namespace
{

constexpr int32 kAutomate = ParameterInfo::kCanAutomate;

// Takes the pending changes of a suspended filter out: their parameter IDs, in order.
std::vector<ParamID> FlushedIDs(FakePlugin& plugin, zebaudiofilterhost::AudioFilter& filter)
{
    std::vector<ParamID> ids;
    plugin.process = [&](ProcessData& data)
    {
        for (int32 index = 0; index < data.inputParameterChanges->getParameterCount(); ++index)
            ids.push_back(data.inputParameterChanges->getParameterData(index)->getParameterId());
        return kResultOk;
    };
    filter.FlushMessageQueue();
    plugin.process = {};
    return ids;
}

} // namespace

TEST(FilterParameters, ApplicationSeesNeitherReadOnlyNorBypassNorPrograms)
{
    FakePlugin plugin;
    plugin.parameters = {{10, kAutomate, u"Gain", u"dB", 3},
                         {11, ParameterInfo::kIsReadOnly},
                         {12, ParameterInfo::kIsBypass},
                         {13, ParameterInfo::kIsProgramChange},
                         {14, 0, u"Hidden"}};
    const auto filter = plugin.MakeFilter();
    ASSERT_EQ(filter->GetParameterCount(), 2);
    const auto gain = filter->GetParameterInfo(0);
    EXPECT_TRUE(gain->GetName() == u"Gain");
    EXPECT_TRUE(gain->GetLabel() == u"dB");
    EXPECT_EQ(gain->GetStepCount(), 3);
    EXPECT_TRUE(gain->CanBeAutomated());
    EXPECT_TRUE(gain->IsExposed());
    EXPECT_TRUE(gain->CanRamp());
    EXPECT_EQ(gain->FromNormalized(0.5F), 5.0F);
    EXPECT_EQ(gain->ToNormalized(5.0F), 0.5F);
    EXPECT_TRUE(gain->GetParameterString(0.5F) == u"10: 0.5");
    const auto hidden = filter->GetParameterInfo(1);
    EXPECT_TRUE(hidden->GetName() == u"Hidden");
    EXPECT_FALSE(hidden->IsExposed());

    // The others travel to the processor all the same.
    for (ParamID id = 9; id < 15; ++id)
        filter->performEdit(id, 0.5);
    EXPECT_THAT(FlushedIDs(plugin, *filter), ElementsAre(10U, 11U, 12U, 13U, 14U));
}

// Nobody asks which parameter is edited while nobody hears of it.
TEST(FilterParameters, EditsReachTheProcessorUnheardAndWhoeverListensFromThenOn)
{
    using Slot = std::function<void(int, float)>;
    const std::vector<std::function<void(VST3AudioFilter&, const Slot&)>> waysToListen = {
        [](VST3AudioFilter& filter, const Slot& slot) { filter.ConnectAutomatedParameterChange(slot); },
        [](VST3AudioFilter& filter, const Slot& slot)
        {
            filter.GetAutomatedParameterChangeSignal().connect(slot);
        }};
    for (const auto& listen : waysToListen)
    {
        FakePlugin plugin;
        plugin.parameters = {{10}, {11}};
        const auto filter = plugin.MakeFilter();
        filter->performEdit(11, 0.25);
        filter->SetParameterAutomated(0, 0.25F);
        EXPECT_THAT(FlushedIDs(plugin, *filter), ElementsAre(10U, 11U));

        std::vector<std::pair<int, float>> heard;
        listen(*filter, [&](int index, float value) { heard.emplace_back(index, value); });
        filter->performEdit(11, 0.5);
        filter->SetParameterAutomated(0, 0.75F);
        EXPECT_THAT(heard, ElementsAre(std::pair(1, 0.5F), std::pair(0, 0.75F)));
        EXPECT_THAT(FlushedIDs(plugin, *filter), ElementsAre(10U, 11U));
    }
}

TEST(FilterParameters, IndicesOutOfRangeFindNothing)
{
    FakePlugin plugin;
    plugin.parameters = {{10}};
    plugin.values[10] = 0.25;
    const auto filter = plugin.MakeFilter();
    EXPECT_EQ(filter->GetParameter(0), 0.25F);
    EXPECT_TRUE(filter->GetParameterString(0) == u"10: 0.25");
    const unsigned int dirty = filter->GetParameterDirtyCount();
    plugin.ClearCalls();
    for (const int index : {-1, 1, 2147483647, -2147483647 - 1})
    {
        EXPECT_EQ(filter->GetParameter(index), 0.0F);
        EXPECT_FALSE(filter->GetParameterInfo(index));
        EXPECT_TRUE(filter->GetParameterString(index).empty());
        filter->SetParameter(index, 0.5F);
    }
    EXPECT_EQ(filter->GetParameterDirtyCount(), dirty + 4);
    EXPECT_TRUE(plugin.Calls().empty());
    EXPECT_TRUE(FlushedIDs(plugin, *filter).empty());
}

TEST(FilterParameters, TextsWithoutTerminatorEndAt128Units)
{
    FakePlugin plugin;
    plugin.parameters = {{10, kAutomate, UTF16String(200, u'x'), u"a\xd800"}};
    const auto info = plugin.MakeFilter()->GetParameterInfo(0);
    EXPECT_TRUE(info->GetName() == UTF16String(128, u'x'));
    EXPECT_TRUE(info->GetLabel() == u"a\xd800");
}

TEST(FilterParameters, CountsThatLieAreNotBelieved)
{
    FakePlugin plugin;
    plugin.parameters = {{10}, {11}};
    plugin.parameterCount = 2147483647;
    EXPECT_EQ(plugin.MakeFilter()->GetParameterCount(), 2);
    plugin.parameterCount = -7;
    EXPECT_EQ(plugin.MakeFilter()->GetParameterCount(), 0);
    // Those that can't be read stay, as parameters without a name.
    plugin.parameterCount = 5000;
    const auto filter = plugin.MakeFilter();
    ASSERT_EQ(filter->GetParameterCount(), 5000);
    EXPECT_TRUE(filter->GetParameterInfo(4999)->GetName().empty());
    EXPECT_FALSE(filter->GetParameterInfo(4999)->IsExposed());
}

TEST(FilterParameters, EditsReachTheApplication)
{
    FakePlugin plugin;
    plugin.parameters = {{9, ParameterInfo::kIsReadOnly}, {10}, {11}};
    const auto filter = plugin.MakeFilter();
    std::vector<std::string> heard;
    filter->ConnectAutomatedParameterChange(
        [&](int index, float value)
        { heard.push_back("set " + std::to_string(index) + " " + std::to_string(value).substr(0, 4)); });
    filter->ConnectEditingStateChange([&](int index, bool begin)
                                      { heard.push_back((begin ? "begin " : "end ") + std::to_string(index)); });
    EXPECT_EQ(filter->beginEdit(11), kResultOk);
    EXPECT_EQ(filter->performEdit(11, 0.75), kResultOk);
    EXPECT_EQ(filter->endEdit(11), kResultOk);
    for (const ParamID unseen : {9U, 99U})
    {
        EXPECT_EQ(filter->beginEdit(unseen), kResultOk);
        EXPECT_EQ(filter->performEdit(unseen, 0.75), kResultOk);
        EXPECT_EQ(filter->endEdit(unseen), kResultOk);
    }
    EXPECT_THAT(heard, ElementsAre("begin 1", "set 1 0.75", "end 1"));
    EXPECT_TRUE(plugin.CallsTo("controller.setParamNormalized").empty());
}

TEST(FilterParameters, RestartComponentReactsToThreeFlags)
{
    FakePlugin plugin;
    plugin.parameters = {{10}};
    const auto filter = plugin.MakeFilter();
    int signals = 0;
    filter->ConnectParameterPropertiesChanged([&] { ++signals; });
    struct Case
    {
        int32 flags;
        tresult result;
        int signals;
        std::size_t latencies;
    };
    for (const Case& expected :
         {Case{0, kResultFalse, 0, 0}, Case{kReloadComponent, kResultFalse, 0, 0},
          Case{kIoChanged, kResultFalse, 0, 0}, Case{kParamValuesChanged, kResultOk, 1, 0},
          Case{kParamTitlesChanged, kResultOk, 1, 0}, Case{kLatencyChanged, kResultOk, 0, 1},
          Case{kParamTitlesChanged | kLatencyChanged, kResultOk, 1, 1},
          Case{~(kParamValuesChanged | kParamTitlesChanged | kLatencyChanged), kResultFalse, 0, 0}})
    {
        signals = 0;
        plugin.ClearCalls();
        EXPECT_EQ(filter->restartComponent(expected.flags), expected.result) << expected.flags;
        EXPECT_EQ(signals, expected.signals) << expected.flags;
        EXPECT_EQ(plugin.CallsTo("processor.getLatencySamples").size(), expected.latencies) << expected.flags;
    }
}

TEST(FilterParameters, RebuildTakesOverNewParametersAndKeepsOldInfosAlive)
{
    FakePlugin plugin;
    plugin.parameters = {{10, kAutomate, u"Old"}};
    auto filter = plugin.MakeFilter();
    const auto old = filter->GetParameterInfo(0);
    filter->SetParameter(0, 0.5F);
    plugin.parameters = {{20, kAutomate, u"New"}, {21}, {22}};
    filter->restartComponent(kParamTitlesChanged);
    ASSERT_EQ(filter->GetParameterCount(), 3);
    EXPECT_TRUE(filter->GetParameterInfo(0)->GetName() == u"New");
    EXPECT_TRUE(old->GetName() == u"Old");
    EXPECT_EQ(old->FromNormalized(0.5F), 5.0F);
    // What was pending for the old parameters is gone.
    EXPECT_TRUE(FlushedIDs(plugin, *filter).empty());
    filter->SetParameter(2, 0.5F);
    EXPECT_THAT(FlushedIDs(plugin, *filter), ElementsAre(22U));
    filter->OnUITimerTick();
    filter.reset();
}

// A plug-in may do so inside the very call that delivers its changes.
TEST(FilterParameters, RebuildInsideAFlushLeavesTheChangesInPlace)
{
    FakePlugin plugin;
    plugin.parameters = {{10}, {11}, {12}};
    const auto filter = plugin.MakeFilter();
    for (int index = 0; index < 3; ++index)
        filter->SetParameter(index, 0.5F);
    std::vector<ParamID> seen;
    plugin.process = [&](ProcessData& data)
    {
        plugin.parameters = {{30}};
        plugin.handler->restartComponent(kParamValuesChanged);
        for (int32 index = 0; index < data.inputParameterChanges->getParameterCount(); ++index)
            seen.push_back(data.inputParameterChanges->getParameterData(index)->getParameterId());
        return kResultOk;
    };
    filter->FlushMessageQueue();
    EXPECT_THAT(seen, ElementsAre(10U, 11U, 12U));
    EXPECT_EQ(filter->GetParameterCount(), 1);
}

TEST(FilterParameters, DirtyPluginCountsAtEveryTick)
{
    FakePlugin plugin;
    plugin.hasVendorEffect = true;
    const auto filter = plugin.MakeFilter();
    const unsigned int before = filter->GetParameterDirtyCount();
    filter->OnUITimerTick();
    EXPECT_EQ(filter->GetParameterDirtyCount(), before);
    plugin.dirty = true;
    filter->OnUITimerTick();
    filter->OnUITimerTick();
    EXPECT_EQ(filter->GetParameterDirtyCount(), before + 2);
}

namespace
{

void AddPrograms(FakePlugin& plugin)
{
    plugin.hasUnits = true;
    UnitInfo other = {};
    other.id = 5;
    other.programListId = 70;
    UnitInfo root = {};
    root.id = kRootUnitId;
    root.programListId = 71;
    plugin.units = {other, root};
    plugin.programLists = {{70, 2, u"First "}, {71, 5, u"Second "}};
    plugin.parameters = {{10},
                         {13, ParameterInfo::kIsProgramChange, u"", u"", 9, 5},
                         {14, ParameterInfo::kIsProgramChange, u"", u"", 4, kRootUnitId},
                         {15, ParameterInfo::kIsProgramChange, u"", u"", 7, kRootUnitId}};
}

} // namespace

TEST(FilterPresets, CountIsTheRootUnitsAndNamesAreTheFirstLists)
{
    FakePlugin plugin;
    AddPrograms(plugin);
    const auto filter = plugin.MakeFilter();
    EXPECT_EQ(filter->GetNumFactoryPresets(), 5);
    EXPECT_TRUE(filter->GetFactoryPresetName(1) == u"First 1");
    plugin.programLists.front().count = 7; // More than the root unit's
    EXPECT_TRUE(filter->GetFactoryPresetName(6) == u"First 6");
    plugin.programLists.front().count = 2;
    EXPECT_TRUE(filter->GetFactoryPresetName(2).empty());
    EXPECT_TRUE(filter->GetFactoryPresetName(-1).empty());
    EXPECT_TRUE(filter->GetFactoryPresetName(5).empty());
}

TEST(FilterPresets, WithoutRootUnitOrListThereAreNone)
{
    struct Case
    {
        const char* name;
        void (*change)(FakePlugin&);
    };
    for (const Case& tried : {Case{"no units",
                                   [](FakePlugin& plugin)
                                   {
                                       plugin.units.clear();
                                   }},
                              Case{"no root",
                                   [](FakePlugin& plugin)
                                   {
                                       plugin.units.pop_back();
                                   }},
                              Case{"no list",
                                   [](FakePlugin& plugin)
                                   {
                                       plugin.units[1].programListId = kNoProgramListId;
                                   }},
                              Case{"unknown list",
                                   [](FakePlugin& plugin)
                                   {
                                       plugin.units[1].programListId = 99;
                                   }},
                              Case{"negative count",
                                   [](FakePlugin& plugin)
                                   {
                                       plugin.programLists[1].count = -3;
                                   }},
                              Case{"no interface", [](FakePlugin& plugin)
                                   {
                                       plugin.hasUnits = false;
                                   }}})
    {
        FakePlugin plugin;
        AddPrograms(plugin);
        tried.change(plugin);
        EXPECT_EQ(plugin.MakeFilter()->GetNumFactoryPresets(), 0) << tried.name;
    }
    FakePlugin liar;
    AddPrograms(liar);
    liar.programLists[1].count = 2147483647;
    EXPECT_LE(liar.MakeFilter()->GetNumFactoryPresets(), 100000);
}

TEST(FilterPresets, SettingOneTurnsTheFirstProgramParameterOfTheRoot)
{
    FakePlugin plugin;
    AddPrograms(plugin);
    const auto filter = plugin.MakeFilter();
    plugin.ClearCalls();
    for (const int index : {-1, 5, 1, 4})
        filter->SetFactoryPreset(index);
    EXPECT_THAT(plugin.CallsTo("controller"),
                ElementsAre("controller.setParamNormalized 14 0.25", "controller.setParamNormalized 14 1"));
    EXPECT_THAT(FlushedIDs(plugin, *filter), ElementsAre(14U));

    plugin.parameters.erase(plugin.parameters.begin() + 1);
    filter->restartComponent(kParamValuesChanged); // the first that was found stays, at its index
    plugin.ClearCalls();
    filter->SetFactoryPreset(7);
    EXPECT_THAT(plugin.CallsTo("controller"), ElementsAre("controller.setParamNormalized 14 1"));
}
