// Paths that a user gives from where he stands, with plug-ins that make another folder the working directory.
#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

constexpr const char* kPlugin = "./ChangesFolder.so";

class WorkingFolderTest : public ZebhostTest
{
protected:
    WorkingFolderTest()
    {
        for (const char* hazard : {"ChangesFolder", "CrashElsewhere"})
        {
            fs::copy(VST2Hazard(hazard), mFolder);
        }
        WriteSound(Path("in.wav"), mInput);
        WriteSound(Path("side.wav"), MakeNoise(2, mInput.Frames()));
    }

    // With a settings folder that is given from there too.
    RunResult RunHere(std::vector<std::string> arguments) const
    {
        arguments.insert(arguments.end(), {"--settings", "settings"});
        return RunInFolder(arguments);
    }
    RunResult SucceedHere(const std::vector<std::string>& arguments) const
    {
        RunResult result = RunHere(arguments);
        EXPECT_EQ(result.code, 0) << testing::PrintToString(arguments) << "\n" << result.err;
        return result;
    }

    Sound mInput = MakeNoise(2, 2000);
};

TEST_F(WorkingFolderTest, ARenderFindsAllItsFiles)
{
    WriteText(Path("moves.csv"), "0,Amount,norm:0.5\n");
    SucceedHere({"preset", "save", kPlugin, "./start.xml"});
    const RunResult result = SucceedHere({"render", kPlugin, "in.wav", "out.wav", "--side-chain", "side.wav",
                                          "--automation", "moves.csv", "--preset", "./start.xml", "--json"});
    EXPECT_TRUE(ReadSound(Path("out.wav")).channels == mInput.channels);
    const nlohmann::json file = result.Json().at("files").at(0);
    EXPECT_EQ(file.at("input"), "in.wav");
    EXPECT_EQ(file.at("output"), "out.wav");
    EXPECT_THAT(result.err, HasSubstr("zebhost: out.wav: "));
}

TEST_F(WorkingFolderTest, EachOfSeveralFilesIsFoundAfterTheOneBefore)
{
    SucceedHere({"render", kPlugin, "in.wav", "side.wav", "--out-dir", "wet"});
    EXPECT_EQ(ReadSound(Path("wet/in.wav")).Frames(), mInput.Frames());
    EXPECT_EQ(ReadSound(Path("wet/side.wav")).Frames(), mInput.Frames());
    const RunResult again = RunHere({"render", kPlugin, "in.wav", "side.wav", "--out-dir", "wet"});
    EXPECT_EQ(again.code, 7);
    EXPECT_THAT(again.LastLine(), StartsWith("zebhost: wet/in.wav exists"));
}

TEST_F(WorkingFolderTest, PresetsComeBackFromStoreAndFile)
{
    for (const char* preset : {"kept", "kept.xml", "deeper/kept.xml"})
    {
        SucceedHere({"preset", "save", kPlugin, preset, "--norm", "Amount=0.25"});
        const nlohmann::json loaded = SucceedHere({"preset", "load", kPlugin, preset, "--json"}).Json();
        EXPECT_EQ(loaded.at("parameters").at(0).at("value"), 0.25) << preset;
    }
    EXPECT_THAT(Files(),
                ElementsAre("ChangesFolder.so", "CrashElsewhere.so", "deeper", "in.wav", "kept.xml", "side.wav"));
    EXPECT_TRUE(fs::is_directory(Settings() / "Presets"));
}

TEST_F(WorkingFolderTest, AScanInTheSameProcessFindsTheNextPluginAndTheCatalogue)
{
    SucceedHere({"scan", "--in-process", kPlugin, "CrashElsewhere.so"});
    EXPECT_EQ(Succeed({"list", "--json"}).Json().at("filters").size(), 2U);
}

TEST_F(WorkingFolderTest, ACrashElsewhereLeavesNoFile)
{
    const std::vector<std::string> before = Files();
    EXPECT_EQ(RunHere({"render", "./CrashElsewhere.so", "in.wav", "out.wav"}).code, 5);
    EXPECT_EQ(Files(), before);
}

TEST_F(WorkingFolderTest, WhatIsMissingIsNamedAsItWasGiven)
{
    const std::vector<std::pair<std::vector<std::string>, std::string>> rows = {
        {{"none.wav", "out.wav"}, "none.wav: there is no such file"},
        {{"in.wav", "none/out.wav"}, "none/out.wav cannot be written"},
        {{"in.wav", "out.wav", "--automation", "none.csv"}, "none.csv cannot be read"},
        {{"in.wav", "out.wav", "--side-chain", "none.wav"}, "none.wav: there is no such file"},
    };
    for (const auto& [options, sentence] : rows)
    {
        std::vector<std::string> words = {"render", kPlugin};
        words.insert(words.end(), options.begin(), options.end());
        const RunResult result = RunHere(words);
        EXPECT_EQ(result.code, 7) << sentence;
        EXPECT_THAT(result.LastLine(), StartsWith("zebhost: " + sentence));
    }
}

// A folder that can be worked in, but not be reached from the top.
TEST_F(WorkingFolderTest, AFolderThatHasNoPathServesToo)
{
    const RunResult result =
        RunProgram({"sh", "-c", R"(mkdir gone && cd gone && rmdir ../gone && exec "$0" list --settings "$1")",
                    ZEBHOST_PROGRAM, Settings().string()},
                   mVariables, mFolder);
    EXPECT_EQ(result.code, 0) << result.err;
}

} // namespace

} // namespace zebtest
