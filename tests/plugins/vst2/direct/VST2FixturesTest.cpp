// The VST 2 fixtures themselves: that each is there, that no two share an ID, that log, switches and commands work.
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/plugins/vst2/FixtureID.h"
#include "tests/plugins/vst2/direct/DirectVST2.h"

#include <gtest/gtest.h>
#include <map>

namespace
{

using namespace zebtest;
using namespace zebaudiofilterhost::vst;

std::vector<std::filesystem::path> All()
{
    std::vector<std::filesystem::path> all;
    for (const auto& entry : std::filesystem::directory_iterator(VST2FixtureFolder()))
        if (entry.path().extension() == ".so" || entry.path().extension() == ".vst")
            all.push_back(entry.path());
    return all;
}

TEST(VST2Fixtures, OpenUnderIDsOfTheirOwn)
{
    std::map<std::int32_t, std::string> owners;
    for (const auto& path : All())
    {
        const std::string name = path.stem().string();
        if (name == "Helper")
        {
            EXPECT_THROW(DirectVST2 helper(path), std::runtime_error);
            continue;
        }
        if (name == "ThrowsInDispatcher" || name == "ThrowsInClose")
            continue;
        const DirectVST2 plugin(path);
        if (name == "NullEntry")
        {
            EXPECT_EQ(plugin.effect, nullptr);
            continue;
        }
        ASSERT_NE(plugin.effect, nullptr) << name;
        EXPECT_EQ(plugin.effect->magic == kEffectMagic, name != "WrongMagic") << name;
        EXPECT_EQ(static_cast<std::uint32_t>(plugin.effect->uniqueID), VST2FixtureID(name)) << name;
        const auto [owner, isNew] = owners.emplace(plugin.effect->uniqueID, name);
        EXPECT_TRUE(isNew) << name << " and " << owner->second;
    }
    EXPECT_GE(owners.size(), 65U);
}

TEST(VST2Fixtures, RecordWhatTheHostCallsInOrder)
{
    const FixtureRecorder recorder = RecorderOf(VST2Fixture("Normal"));
    recorder.Clear();
    {
        DirectVST2 plugin(VST2Fixture("Normal"));
        EXPECT_EQ(recorder.LiveObjects(), 1);
        EXPECT_TRUE(plugin.Arrange(kSpeakerArrMono, 1));
        plugin.Resume(48000.0F, 64);
        plugin.effect->setParameter(plugin.effect, 1, 0.25F);
        EXPECT_EQ(plugin.effect->getParameter(plugin.effect, 1), 0.25F);
        EXPECT_EQ(plugin.Text(effGetParamDisplay, 1), "25%");
        plugin.Process({{1.0F, 0.5F}});
        plugin.Call(effSetProgram, 0, 2);
        plugin.Call(effVendorSpecific, static_cast<std::int32_t>(0x80000009), 1, nullptr, 0.5F);
        EXPECT_EQ(plugin.Chunk(true).size(), 12U);
        plugin.SetChunk(true, "short");
    }
    EXPECT_EQ(recorder.LiveObjects(), 0);
    const std::vector<std::string> expected{
        "VSTPluginMain 1",
        "effOpen",
        "effSetSpeakerArrangement 0:1: 0:1:",
        "effSetSampleRate 48000",
        "effSetBlockSize 64",
        "effMainsChanged 1",
        "effStartProcess",
        "setParameter 1 0.25",
        "getParameter 1",
        "effGetParamDisplay 1",
        "processReplacing 2 1 1 null= 0",
        "effSetProgram 2",
        "effVendorSpecific 0x80000009 1 0.5",
        "effGetChunk 1",
        "effSetChunk 1 5 hash=" + std::to_string(VST2FixtureID("short")),
        "effMainsChanged 0",
        "effClose",
    };
    EXPECT_EQ(recorder.Calls(), expected);
}

TEST(VST2Fixtures, DoWhatTheirKnobsSay)
{
    const FixtureRecorder recorder = RecorderOf(VST2Fixture("Normal"));
    DirectVST2 plugin(VST2Fixture("Normal"));
    recorder.Set("latency", 77);
    recorder.Set("parameterCount", 20);
    recorder.Set("processThrows", 2);
    EXPECT_EQ(plugin.effect->initialDelay, 77);
    EXPECT_EQ(plugin.effect->numParams, 20);
    EXPECT_EQ(plugin.Text(effGetParamName, 19), "More");
    EXPECT_THROW(plugin.Process({{1.0F}}), int);
    recorder.Reset();
    EXPECT_EQ(plugin.effect->initialDelay, 0);
    EXPECT_THROW(recorder.Set("nothing of the kind", 1), std::invalid_argument);

    recorder.Clear();
    recorder.SetRecording(false);
    plugin.Process({{1.0F}});
    recorder.SetRecording(true);
    EXPECT_TRUE(recorder.Calls().empty());
}

TEST(VST2Fixtures, CallTheirHostOnCommand)
{
    const FixtureRecorder recorder = RecorderOf(VST2Fixture("Bundled"));
    EXPECT_EQ(recorder.Do("audioMasterVersion"), "none");
    DirectVST2 plugin(VST2Fixture("Bundled"));
    EXPECT_EQ(recorder.Do("audioMasterVersion"), "2400");
    EXPECT_EQ(recorder.Do("noEffect audioMasterSizeWindow 3 4"), "0");
    EXPECT_EQ(recorder.Do("thread audioMasterSizeWindow 5 6"), "1");
    EXPECT_EQ(recorder.Do("audioMasterAutomate 2 0 0.5"), "0");
    EXPECT_EQ(plugin.told, (std::vector<std::string>{"size 5 6", "automate 2"}));
    EXPECT_EQ(plugin.lastValue, 0.5F);
    EXPECT_EQ(recorder.Do("sing"), "unknown");
}

// What the name of the binary says, where it is about the first moments.
TEST(VST2Fixtures, CallTheirHostWhenTheirNamesSay)
{
    for (const auto& [name, prefixes] : std::map<std::string, std::vector<std::string>>{
             {"CallsInEntry", {"entry.", "made."}}, {"CallsInOpen", {"open."}}, {"CallsInClose", {"close."}}})
    {
        const FixtureRecorder recorder = RecorderOf(VST2Fixture(name));
        recorder.Clear();
        {
            const DirectVST2 plugin(VST2Fixture(name));
        }
        for (const std::string& prefix : prefixes)
            EXPECT_EQ(recorder.CallsTo(prefix + "audioMasterVersion"),
                      std::vector<std::string>{prefix + "audioMasterVersion -> 2400"});
    }
}

TEST(VST2Fixtures, WithTwoEntryPointsHaveBoth)
{
    const FixtureRecorder recorder = RecorderOf(VST2Fixture("BothEntries"));
    {
        const DirectVST2 plugin(VST2Fixture("BothEntries"));
        const DirectVST2 macho(VST2Fixture("MachoEntry"));
        const DirectVST2 old(VST2Fixture("OldMain"));
    }
    EXPECT_EQ(recorder.Calls().front(), "VSTPluginMain 1");
    EXPECT_EQ(RecorderOf(VST2Fixture("MachoEntry")).Calls().front(), "main_macho 1");
    EXPECT_EQ(RecorderOf(VST2Fixture("OldMain")).Calls().front(), "main 1");
}

} // namespace
