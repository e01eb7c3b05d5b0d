// Life of a VST 2 filter: exact orders, names, parameters, and plug-ins that lie or throw.

#include "host/AudioFilterDescriptor.h"
#include "tests/vst/support/FakeFilter.h"

#include <gmock/gmock.h>

#include <limits>

using namespace fakeeffect;
using testing::Each;
using testing::ElementsAre;
using testing::Not;
using testing::StartsWith;

namespace
{

using Life = FilterTest;

std::vector<std::pair<int, float>> SettingsOf(const std::vector<Call>& calls)
{
    std::vector<std::pair<int, float>> settings;
    for (const Call& call : calls)
        settings.emplace_back(static_cast<int>(call.value), call.opt);
    return settings;
}

} // namespace

TEST_F(Life, ConstructionCallsInOrder)
{
    fake.effect.numParams = 2;
    Make();
    std::vector<std::string> names = fake.Names();
    ASSERT_GT(names.size(), 4U);
    names.resize(4);
    EXPECT_THAT(names, ElementsAre("effOpen", "effSetSampleRate", "effSetBlockSize", "effGetEffectName"));
    const std::vector<Call> parameters = fake.CallsTo("effGetParamName");
    ASSERT_EQ(parameters.size(), 2U);
    EXPECT_EQ(parameters[0].index, 0);
    EXPECT_EQ(parameters[1].index, 1);
    EXPECT_THAT(SettingsOf(fake.CallsTo("effSetSampleRate")), ElementsAre(std::pair(0, 44100.0F)));
    EXPECT_THAT(SettingsOf(fake.CallsTo("effSetBlockSize")), ElementsAre(std::pair(2048, 0.0F)));
    EXPECT_EQ(filter->GetID(), u"2:1234 Fake");
}

TEST_F(Life, DestructionOnlyCloses)
{
    MakeRunning();
    fake.ClearCalls();
    filter.reset();
    EXPECT_THAT(fake.Names(), ElementsAre("effClose"));
    EXPECT_EQ(fake.callsAfterClose, 0);
}

TEST_F(Life, IsNamedAfterItselfOrItsFile)
{
    struct
    {
        const char* ownName;
        bool useFileTitle;
        const char16_t* name;
    } const rows[] = {
        {"Own", false, u"Own"},       {"Own", true, u"Title.of.file"}, {"", false, u"Title.of.file"},
        {"", true, u"Title.of.file"}, {"\xc3\xa9", false, u"\u00e9"},
    };
    for (const auto& row : rows)
    {
        fake.Text(effGetEffectName, row.ownName);
        EXPECT_EQ(MakeFilter(fake, u"id", row.useFileTitle)->GetDisplayName(), row.name) << row.ownName;
    }
}

TEST_F(Life, OnePlugInIsKnownToBeExpensive)
{
    const std::pair<const char16_t*, bool> rows[] = {
        {u"2:1517179725 PlainFinisher", true},
        {u"2:1517179725 PlainFinisher2", false},
        {u"2:1517179725 plainfinisher", false},
        {u"1517179725 PlainFinisher", false},
        {u"2:1517179725 PlainFinishe", false},
        {u"2:1517179726 PlainFinisher", false},
        {u"", false},
    };
    for (const auto& [id, expensive] : rows)
        EXPECT_EQ(MakeFilter(fake, id)->GetHasHighCPU(), expensive) << testing::PrintToString(id);
}

// The filter counts as running before the plug-in is switched on, and until it is switched off.
TEST_F(Life, ResumeAndSuspendSwitchInOrder)
{
    Make();
    std::vector<std::string> order;
    const auto note = [&order](std::string step)
    {
        return [&order, step](int, long long value, void*, float)
        {
            order.push_back(step + std::to_string(value));
            return 0LL;
        };
    };
    fake.On(effMainsChanged, note("mains "));
    fake.On(effStartProcess, note("start "));
    fake.On(effStopProcess, note("stop "));
    filter->ConnectSuspendedStateChanged([&order](bool suspended)
                                         { order.push_back(suspended ? "suspended" : "running"); });
    filter->Resume();
    filter->Suspend();
    EXPECT_THAT(order, ElementsAre("running", "mains 1", "start 0", "stop 0", "mains 0", "suspended"));
}

TEST_F(Life, RateAndBlockSizeReachThePlugInAtOnce)
{
    MakeRunning();
    fake.ClearCalls();
    filter->SetSampleRate(96000.0F);
    filter->SetBlockSize(256);
    EXPECT_THAT(fake.Names(), ElementsAre("effSetSampleRate", "effSetBlockSize"));
    EXPECT_THAT(SettingsOf(fake.Calls()), ElementsAre(std::pair(0, 96000.0F), std::pair(256, 0.0F)));
    EXPECT_EQ(filter->GetMaxProcessingBlockSize(), 1024);
}

TEST_F(Life, LatencyIsReadEachTime)
{
    Make();
    for (const int latency : {0, 512, 7, -1})
    {
        fake.effect.initialDelay = latency;
        EXPECT_EQ(filter->GetInitialDelay(), latency);
    }
}

TEST_F(Life, ParametersGoToThePlugInAndAreCounted)
{
    fake.effect.numParams = 2;
    fake.parameters = {0.25F, 0.5F};
    Make();
    fake.ClearCalls();
    EXPECT_EQ(filter->GetParameter(1), 0.5F);
    filter->SetParameter(1, 0.75F);
    EXPECT_EQ(fake.parameters[1], 0.75F);
    EXPECT_EQ(filter->GetParameterDirtyCount(), 1U);
    EXPECT_TRUE(filter->GetParameterInfo(1));
    fake.ClearCalls();
    for (const int index : {-1, 2, std::numeric_limits<int>::max()})
    {
        filter->SetParameter(index, 1.0F);
        EXPECT_EQ(filter->GetParameter(index), 0.0F);
        EXPECT_FALSE(filter->GetParameterInfo(index));
    }
    EXPECT_THAT(fake.Names(), ElementsAre()) << "an index out of range reached the plug-in";
    EXPECT_EQ(filter->GetParameterDirtyCount(), 4U);
}

TEST_F(Life, AbsurdParameterCountsAreNotBelieved)
{
    fake.recording = false;
    for (const int count : {-1, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()})
    {
        fake.effect.numParams = count;
        Make();
        EXPECT_EQ(filter->GetParameterCount(), count < 0 ? 0 : 32768);
        EXPECT_EQ(filter->GetParameterInfo(0) != nullptr, count > 0);
    }
}

TEST_F(Life, APlugInWithoutADispatcherStillComesUpAndGoes)
{
    fake.effect.dispatcher = nullptr;
    fake.effect.numParams = 1;
    MakeRunning();
    EXPECT_EQ(filter->GetDisplayName(), u"Title.of.file");
    EXPECT_TRUE(filter->CreateFilterDescriptor({}, false));
    EXPECT_EQ(filter->GetParameterString(0), u"0"); // the value itself
    filter->Suspend();
    filter.reset();
    EXPECT_THAT(fake.Names(), Each(Not(StartsWith("eff"))));
}

TEST_F(Life, APlugInThatThrowsEverywhereStillComesUpAndGoes)
{
    for (const auto opcode : {effOpen, effSetSampleRate, effSetBlockSize, effGetEffectName, effGetParamName,
                              effGetParameterProperties, effMainsChanged, effStartProcess, effStopProcess, effClose})
        fake.Throw(opcode);
    fake.effect.numParams = 1;
    MakeRunning();
    EXPECT_EQ(filter->GetDisplayName(), u"Title.of.file");
    EXPECT_EQ(filter->GetParameterCount(), 1);
    filter->Suspend();
    filter.reset();
    EXPECT_EQ(fake.Count("effClose"), 1U);
}
