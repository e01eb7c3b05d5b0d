#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

#include <array>

namespace zebtest
{

namespace
{

using testing::HasSubstr;

class CrashTest : public ZebhostTest
{
};

TEST_F(CrashTest, APluginThatEndsTheScanIsBlockedAndTheNextScanGoesOn)
{
    SearchIn(mFolder / "plugins");
    std::filesystem::create_directories(mFolder / "plugins");
    for (const std::filesystem::path& bundle :
         {HazardBundle("CrashOnLoad"), HazardBundle("AbortInEntry"), EffectBundle("ZebGain")})
    {
        std::filesystem::create_directory_symlink(bundle, mFolder / "plugins" / bundle.filename());
    }
    for (const char* name : {"AbortInEntry", "CrashOnLoad"})
    {
        const RunResult result = Run({"scan"});
        EXPECT_EQ(result.code, 5);
        EXPECT_THAT(result.LastLine(), HasSubstr(std::string(name) + ".vst3 crashed"));
    }
    Succeed({"scan"});
    EXPECT_THAT(Succeed({"list", "--names"}).out, HasSubstr("Zeb Gain"));
    const nlohmann::json blocks = Succeed({"blocks", "--json"}).Json();
    ASSERT_EQ(blocks.at("blocked").size(), 2U);
    for (const nlohmann::json& block : blocks.at("blocked"))
    {
        EXPECT_NE(block.at("reason"), "");
        EXPECT_NE(block.at("since"), "");
    }
}

TEST_F(CrashTest, EveryWayToEndTheProcessIsOneOfThem)
{
    for (const char* name : {"CrashInEntry", "CrashInGetPluginFactory", "CrashOnCreate", "CrashOnInitialize"})
    {
        const RunResult result = Run({"scan", HazardBundle(name).string(), "--json"});
        EXPECT_EQ(result.code, 5) << name << result.err;
        EXPECT_EQ(result.Json().at("error").at("kind"), "crashed") << name;
        EXPECT_THAT(result.LastLine(), HasSubstr(name));
    }
}

TEST_F(CrashTest, AHangIsEndedByTheTimeout)
{
    const RunResult result = Run({"scan", HazardBundle("HangInEntry").string(), "--timeout", "1"});
    EXPECT_EQ(result.code, 5);
    EXPECT_THAT(result.LastLine(), HasSubstr("did not answer for 1 seconds"));
    EXPECT_EQ(Run({"scan", HazardBundle("HangInEntry").string()}).code, 6);
}

TEST_F(CrashTest, APluginThatEndsTheProcessWithoutAWordIsBlockedAllTheSame)
{
    Run({"scan", HazardBundle("ExitInEntry").string()});
    EXPECT_EQ(Run({"scan", HazardBundle("ExitInEntry").string()}).code, 6);
}

TEST_F(CrashTest, APluginThatThrowsFailsAndIsNotBlocked)
{
    for (const char* name : {"ThrowInEntry", "ThrowOnCreate"})
    {
        for (const char* command : {"scan", "info"})
        {
            const RunResult result = Run({command, HazardBundle(name).string()});
            EXPECT_EQ(result.code, 4) << name << result.err;
            EXPECT_THAT(result.LastLine(), HasSubstr("threw an exception"));
        }
    }
}

TEST_F(CrashTest, WhatAPluginPrintsDoesNotGetIntoTheData)
{
    const RunResult result = Run({"scan", HazardBundle("ChatterInEntry").string(), "--json", "--timeout", "1"});
    const nlohmann::json document = result.Json();
    EXPECT_EQ(document.at("schema"), 1);
}

TEST_F(CrashTest, ACrashAtTheEndOfTheProcessChangesNothing)
{
    const RunResult result = Run({"info", HazardBundle("CrashAtExit").string(), "--json"});
    EXPECT_EQ(result.code, 0) << result.err;
    EXPECT_EQ(result.Json().at("ok"), true);
}

TEST_F(CrashTest, ACrashInARenderLeavesNoFile)
{
    WriteSound(Path("in.wav"), MakeNoise(2, 1000));
    const RunResult result =
        Run({"render", HazardBundle("CrashOnInitialize").string(), Path("in.wav"), Path("out.wav")});
    EXPECT_EQ(result.code, 5);
    EXPECT_EQ(Files(), std::vector<std::string>{"in.wav"});
}

} // namespace

} // namespace zebtest
