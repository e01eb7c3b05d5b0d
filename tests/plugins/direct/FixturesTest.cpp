// The fixtures themselves: that each is there, that no two share a class ID, that log, switches and commands work.
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/plugins/direct/DirectPlugin.h"

#include <gtest/gtest.h>
#include <map>
#include <set>

namespace
{

using namespace zebtest;

const std::set<std::string> kUnloadable{"WindowsOnly",   "OtherArchitecture", "NotABinary",
                                        "ForeignBinary", "EmptyBundle",       "PlainFile"};

TEST(Fixtures, LoadUnlessTheyAreMeantNotTo)
{
    std::size_t loaded = 0;
    std::map<std::string, std::string> owners; // class ID to bundle
    for (const auto& entry : std::filesystem::directory_iterator(FixtureFolder()))
    {
        const std::string name = entry.path().stem().string();
        if (entry.path().extension() != ".vst3")
            continue;
        if (kUnloadable.contains(name))
        {
            EXPECT_THROW(OpenBundle(entry.path()), std::runtime_error) << name;
            continue;
        }
        ++loaded;
        IPluginFactory* factory = OpenBundle(entry.path());
        PClassInfo info;
        for (int32 i = 0; factory != nullptr && i < 4 && factory->getClassInfo(i, &info) == kResultOk; ++i)
        {
            const auto [owner, isNew] = owners.emplace(std::string(info.cid, sizeof(TUID)), name);
            EXPECT_TRUE(isNew) << name << " and " << owner->second;
        }
    }
    EXPECT_GE(loaded, 60U);
}

TEST(Fixtures, RecordWhatTheHostCallsInOrder)
{
    const FixtureRecorder recorder = RecorderOf(FixtureBundle("Normal"));
    recorder.Clear();
    {
        DirectPlugin plugin(FixtureBundle("Normal"));
        EXPECT_EQ(recorder.LiveObjects(), 2);
        plugin.Activate(48000.0, 64);
        plugin.Process({{1.0F, 1.0F}, {1.0F, 1.0F}}, {{7, 1, 0.5}}, 2);
    }
    EXPECT_EQ(recorder.LiveObjects(), 0);
    const std::vector<std::string> expected{
        "module.ModuleEntry 1",
        "module.GetPluginFactory",
        "factory.createInstance component",
        "component.created",
        "component.initialize",
        "factory.createInstance controller",
        "controller.created",
        "controller.initialize",
        "controller.setComponentHandler 1",
        "component.connect 1",
        "controller.connect 1",
        "processor.setupProcessing 0 0 64 48000",
        "component.setActive 1",
        "processor.setProcessing 1",
        "processor.process 2 in=2 out=2 silence=2 points=7@1:0.5",
        "processor.setProcessing 0",
        "component.setActive 0",
        "component.disconnect 1",
        "controller.disconnect 1",
        "controller.setComponentHandler 0",
        "controller.terminate",
        "component.terminate",
        "controller.destroyed",
        "component.destroyed",
    };
    EXPECT_EQ(recorder.Calls(), expected);
    recorder.Clear();
    EXPECT_TRUE(recorder.Calls().empty());
}

TEST(Fixtures, DoWhatTheirKnobsSay)
{
    const FixtureRecorder recorder = RecorderOf(FixtureBundle("Normal"));
    DirectPlugin plugin(FixtureBundle("Normal"));
    recorder.Set("latency", 77);
    recorder.Set("processThrows", 2);
    EXPECT_EQ(plugin.processor->getLatencySamples(), 77U);
    EXPECT_THROW(plugin.Process({{1.0F}, {1.0F}}), int);
    recorder.Reset();
    EXPECT_EQ(plugin.processor->getLatencySamples(), 0U);
    EXPECT_THROW(recorder.Set("nothing of the kind", 1), std::invalid_argument);

    recorder.Clear();
    recorder.SetRecording(false);
    plugin.Process({{1.0F}, {1.0F}});
    recorder.SetRecording(true);
    EXPECT_TRUE(recorder.Calls().empty());
}

TEST(Fixtures, CallTheirHostOnCommand)
{
    const FixtureRecorder recorder = RecorderOf(FixtureBundle("Normal"));
    EXPECT_EQ(recorder.Do("performEdit 7 0.5"), "none");
    DirectPlugin plugin(FixtureBundle("Normal"));
    EXPECT_EQ(recorder.Do("performEdit 7 0.5"), "0");
    EXPECT_EQ(plugin.host->told, std::vector<std::string>{"perform 7"});
    EXPECT_EQ(plugin.host->lastValue, 0.5);
    EXPECT_EQ(recorder.Do("hostName"), "Direct");
    EXPECT_EQ(recorder.Do("makeMessage"), "Hello 3 42");
    EXPECT_EQ(recorder.Do("sing"), "unknown");
}

TEST(Fixtures, WithoutAFactoryOrAnEntryHaveNone)
{
    EXPECT_EQ(OpenBundle(FixtureBundle("NoFactory")), nullptr);
    EXPECT_EQ(OpenBundle(FixtureBundle("NullFactory")), nullptr);
    EXPECT_NE(OpenBundle(FixtureBundle("NoEntry")), nullptr);
    EXPECT_EQ(RecorderOf(FixtureBundle("NoEntry")).Count("module.ModuleEntry"), 0U);
}

TEST(Fixtures, FullNamesFillAllSixtyFourUnits)
{
    const FUnknownPtr<IPluginFactory3> factory(OpenBundle(FixtureBundle("FullNames")));
    ASSERT_NE(factory, nullptr);
    PClassInfoW info;
    ASSERT_EQ(factory->getClassInfoUnicode(0, &info), kResultOk);
    const std::u16string_view name(info.name, 64);
    EXPECT_EQ(name.find(u'\0'), std::u16string_view::npos);
    EXPECT_NE(name.find(static_cast<char16_t>(0xd800)), std::u16string_view::npos);
    EXPECT_EQ(name.back(), 0xdbff);
}

} // namespace
