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
    EXPECT_THAT(result.LastLine(), HasSubstr("did not answer for 1 second"));
    EXPECT_EQ(Run({"scan", HazardBundle("HangInEntry").string()}).code, 6);
}

TEST_F(CrashTest, APluginThatEndsTheProcessWithoutAWordIsBlockedAllTheSame)
{
    Run({"scan", HazardBundle("ExitInEntry").string()});
    EXPECT_EQ(Run({"scan", HazardBundle("ExitInEntry").string()}).code, 6);
}

TEST_F(CrashTest, APluginThatEndsTheProcessDoesNotEndACommandWell)
{
    const RunResult result = Run({"info", HazardBundle("ExitInEntry").string(), "--json"});
    EXPECT_EQ(result.code, 5) << result.err;
    EXPECT_EQ(result.Json().at("error").at("kind"), "crashed");
    EXPECT_THAT(result.LastLine(), HasSubstr("ExitInEntry"));
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
