#include "tests/scan/support/ScanFolder.h"

#include <fstream>

#include <sys/stat.h>

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Pair;

// What is scanned, and what is not.
class ScanPlanTest : public ScanFolder
{
protected:
    // What a scan would do, by name.
    std::map<std::string, std::string> Planned(std::vector<std::string> options = {}) const
    {
        options.insert(options.begin(), {"scan", "--dry-run", "--json"});
        return Reasons(Succeed(options).Json());
    }

    static fs::file_time_type Time(const fs::path& file) { return fs::last_write_time(file); }

    static void Append(const fs::path& file) { std::ofstream(file, std::ios::binary | std::ios::app) << "more"; }
};

TEST_F(ScanPlanTest, AChangedBinaryIsScannedAgainAndNothingElse)
{
    struct Change
    {
        const char* what;
        void (*make)(const fs::path& binary);
    };
    const Change changes[] = {
        {"a nanosecond later",
         [](const fs::path& binary)
         {
             fs::last_write_time(binary, Time(binary) + std::chrono::nanoseconds(1));
         }},
        {"an older one",
         [](const fs::path& binary)
         {
             fs::last_write_time(binary, Time(binary) - std::chrono::hours(1));
         }},
        {"another size at the same time",
         [](const fs::path& binary)
         {
             const fs::file_time_type time = Time(binary);
             Append(binary);
             fs::last_write_time(binary, time);
         }},
    };
    AddBundle("a");
    AddBundle("b");
    Succeed({"scan"});
    for (const Change& change : changes)
    {
        change.make(Binary("b"));
        EXPECT_THAT(Planned(), ElementsAre(Pair("b", "changed"))) << change.what;
        ForgetLoads();
        EXPECT_THAT(States(Succeed({"scan", "--json"}).Json()), ElementsAre(Pair("b", "scanned"))) << change.what;
        EXPECT_THAT(CountLoads(), ElementsAre(Pair("b", 1))) << change.what;
        EXPECT_THAT(Planned(), IsEmpty()) << change.what;
    }
    fs::last_write_time(Bundle("a"), Time(Bundle("a")) + std::chrono::hours(1));
    EXPECT_THAT(Planned(), IsEmpty()) << "the bundle is not its binary";
}

TEST_F(ScanPlanTest, AnUnchangedCatalogueOpensNoBinary)
{
    AddBundle("a");
    AddBundle("b-segv");
    AddBundle("c");
    Append(Binary("c"));               // still loads
    fs::resize_file(Binary("c"), 100); // and now it doesn't
    Succeed({"scan", "--quiet"});
    ForgetLoads();
    // What can't be opened can't have been.
    for (const char* name : {"a", "b-segv", "c"})
    {
        ASSERT_EQ(chmod(Binary(name).c_str(), 0), 0);
    }
    EXPECT_THAT(States(Succeed({"scan", "--json"}).Json()),
                ElementsAre(Pair("b-segv", "blocked"), Pair("c", "failed")));
    EXPECT_THAT(Records(), ElementsAre("a"));
    EXPECT_THAT(Loads(), IsEmpty());
    EXPECT_THAT(Succeed({"scan", "--trace", "all"}).err, testing::Not(HasSubstr("Load")));
}

TEST_F(ScanPlanTest, WhatCouldNotBeLoadedIsTriedAgainOnRequestOrWhenItHasChanged)
{
    AddBundle("a");
    fs::resize_file(Binary("a"), 100);
    const std::string problem = Reasons(Succeed({"scan", "--json"}).Json()).at("a");
    EXPECT_THAT(problem, HasSubstr("a.vst3"));
    EXPECT_THAT(Planned(), ElementsAre(Pair("a", problem)));
    EXPECT_THAT(Planned({"--full"}), ElementsAre(Pair("a", "failed before")));
    EXPECT_THAT(Planned({"--retry-blocked"}), ElementsAre(Pair("a", "failed before")));
    EXPECT_THAT(Planned({Bundle("a").string()}), ElementsAre(Pair("a", "asked for")));
    fs::remove_all(Bundle("a"));
    AddBundle("a");
    EXPECT_THAT(Planned(), ElementsAre(Pair("a", "changed")));
    Succeed({"scan"});
    EXPECT_THAT(Records(), ElementsAre("a"));
}

TEST_F(ScanPlanTest, AKnownPluginThatFailsKeepsItsRecordAndIsTriedAgain)
{
    const std::string modes[] = {"--quiet", "--in-process"};
    for (const std::string& mode : modes)
    {
        AddBundle("a");
        Succeed({"scan"});
        const std::string listed = Succeed({"list", "--json"}).out;
        fs::resize_file(Binary("a"), 100);
        const nlohmann::json failed = Succeed({"scan", "--json", mode}).Json();
        EXPECT_THAT(States(failed), ElementsAre(Pair("a", "failed"))) << mode;
        EXPECT_THAT(Records(), ElementsAre("a")) << mode;
        EXPECT_EQ(Succeed({"list", "--json"}).out, listed) << mode;
        EXPECT_THAT(Planned(), ElementsAre(Pair("a", "changed"))) << mode;
        fs::remove_all(Bundle("a"));
        AddBundle("a");
        EXPECT_THAT(States(Succeed({"scan", "--json", mode}).Json()), ElementsAre(Pair("a", "scanned"))) << mode;
        EXPECT_THAT(Planned(), IsEmpty()) << mode;
        fs::remove_all(Bundle("a"));
        Succeed({"scan"});
    }
}

TEST_F(ScanPlanTest, ABlockedPluginIsOfferedAgainWhenItsBinaryHasChanged)
{
    AddBundle("a-segv");
    Succeed({"scan"});
    EXPECT_THAT(Planned(), ElementsAre(Pair("a-segv", HasSubstr("SIGSEGV"))));
    Append(Binary("a-segv"));
    EXPECT_THAT(Planned(), ElementsAre(Pair("a-segv", "was blocked, and has changed")));
    mVariables["ZEB_TEST_CALM"] = "1";
    Succeed({"scan"});
    EXPECT_THAT(Records(), ElementsAre("a-segv"));
    EXPECT_THAT(Blocks(), IsEmpty());
}

TEST_F(ScanPlanTest, ABlockMadeByHandOutlastsAnUpdate)
{
    AddBundle("a");
    Succeed({"block", Bundle("a").string()});
    Append(Binary("a"));
    EXPECT_THAT(Planned(), ElementsAre(Pair("a", "blocked by hand")));
}

TEST_F(ScanPlanTest, BlockedPluginsAreRetriedOnRequest)
{
    AddBundle("a-segv");
    AddBundle("b");
    AddBundle("c");
    Succeed({"scan"});
    Succeed({"block", Bundle("c").string()});
    Succeed({"scan"});
    EXPECT_THAT(Records(), ElementsAre("b"));
    EXPECT_EQ(Run({"scan", Bundle("a-segv").string()}).code, 6);
    EXPECT_THAT(Planned({"--retry-blocked"}),
                ElementsAre(Pair("a-segv", "was blocked"), Pair("c", "blocked by hand")));
    EXPECT_EQ(Run({"scan", "--retry-blocked", Bundle("c").string()}).code, 6);
    EXPECT_THAT(States(Succeed({"scan", "--retry-blocked", "--json"}).Json()),
                ElementsAre(Pair("a-segv", "crashed"), Pair("c", "blocked")));
    EXPECT_THAT(Blocks(), ElementsAre(Pair("a-segv", HasSubstr("SIGSEGV")), Pair("c", "blocked by hand")));
    mVariables["ZEB_TEST_CALM"] = "1";
    Succeed({"scan", "--retry-blocked", Bundle("a-segv").string()});
    EXPECT_THAT(Records(), ElementsAre("a-segv", "b"));
    EXPECT_THAT(Blocks(), ElementsAre(Pair("c", "blocked by hand")));
}

TEST_F(ScanPlanTest, AFullScanTakesWhatIsThereAndLeavesWhatIsBlocked)
{
    AddBundle("a");
    AddBundle("b-segv");
    Succeed({"scan"});
    ForgetLoads();
    EXPECT_THAT(Planned({"--full"}), ElementsAre(Pair("a", "full scan"), Pair("b-segv", HasSubstr("SIGSEGV"))));
    Succeed({"scan", "--full"});
    EXPECT_THAT(CountLoads(), ElementsAre(Pair("a", 1)));
}

TEST_F(ScanPlanTest, ARecordOfAPluginThatNowCrashesLeavesTheCatalogue)
{
    AddBundle("a-segv");
    mVariables["ZEB_TEST_CALM"] = "1";
    Succeed({"scan"});
    EXPECT_THAT(Records(), ElementsAre("a-segv"));
    mVariables["ZEB_TEST_CALM"] = "";
    Succeed({"scan", "--full"});
    EXPECT_THAT(Records(), IsEmpty());
    EXPECT_THAT(Succeed({"list", "--names"}).out, IsEmpty());
    Succeed({"unblock", "a-segv"});
    EXPECT_THAT(Planned(), ElementsAre(Pair("a-segv", "was unblocked")));
}

// Catalogues of other programs, or of a time before binaries were looked at.
TEST_F(ScanPlanTest, WithoutKnowledgeOfBinariesRecordsCountAsCurrent)
{
    AddBundle("a");
    Succeed({"scan"});
    ForgetLoads();
    for (const char* text : {"", "{", "[1]", "{\"version\":1,\"binaries\":{\"3:x\":{\"binary\":{\"time\":\"x\"}}}}"})
    {
        WriteText(Settings() / "AudioPluginManagerSettings.binaries.json", text);
        Succeed({"scan"});
        EXPECT_THAT(Loads(), IsEmpty()) << text;
    }
    Append(Binary("a"));
    EXPECT_THAT(Planned(), ElementsAre(Pair("a", "changed"))) << "learnt by the last scan";
}

TEST_F(ScanPlanTest, PathsOfAnyBytesReachTheWorker)
{
    const std::string names[] = {"a b & <c> \"d\"", "\xC3\xA9\xE2\x82\xAC", "not UTF-8 \xFF"};
    for (const std::string& name : names)
    {
        AddBundle(name);
    }
    EXPECT_THAT(Succeed({"scan"}).LastLine(), HasSubstr("3 plug-ins scanned"));
    EXPECT_EQ(Succeed({"list", "--json"}).Json().at("filters").size(), 3U);
    EXPECT_THAT(Planned(), IsEmpty());
}

} // namespace

} // namespace zebtest
