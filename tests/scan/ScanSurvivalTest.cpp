#include "tests/plugins/FixturePaths.h"
#include "tests/scan/support/ScanFolder.h"

#include <iomanip>
#include <sstream>

namespace zebtest
{

namespace
{

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;
using testing::Pair;

struct Fault
{
    const char* word;
    const char* state;
    const char* reason;
};

constexpr Fault kFaults[] = {{"segv", "crashed", "SIGSEGV"},
                             {"abort", "crashed", "SIGABRT"},
                             {"hang", "timed-out", "did not answer"},
                             {"chatter", "timed-out", "did not answer"}};

class ScanSurvivalTest : public ScanFolder
{
};

// Every fifth bundle is faulty, so that each kind of fault has good ones before and behind it.
TEST_F(ScanSurvivalTest, TwoHundredBundlesOfWhichFortyAreFaulty)
{
    std::map<std::string, const Fault*> bundles;
    for (int index = 0; index < 200; ++index)
    {
        const Fault* fault = index % 5 == 3 ? &kFaults[index / 5 % 4] : nullptr;
        std::ostringstream name;
        name << "p" << std::setw(3) << std::setfill('0') << index << (fault == nullptr ? "" : "-")
             << (fault == nullptr ? "" : fault->word);
        bundles[name.str()] = fault;
        AddBundle(name.str());
    }
    const RunResult result = Run({"scan", "--json", "--quiet", "--timeout", Seconds(1)});
    ASSERT_EQ(result.code, 0) << result.err;
    const nlohmann::json document = result.Json();
    EXPECT_EQ(document.at("restarts"), 40);

    const std::map<std::string, std::string> states = States(document);
    const std::map<std::string, std::string> blocks = Blocks();
    const std::set<std::string> records = Records();
    std::map<std::string, int> onceEach;
    ASSERT_EQ(states.size(), 200U);
    for (const auto& [name, fault] : bundles)
    {
        onceEach[name] = 1;
        EXPECT_EQ(states.at(name), fault == nullptr ? "scanned" : fault->state) << name;
        EXPECT_EQ(records.count(name), fault == nullptr ? 1U : 0U) << name;
        ASSERT_EQ(blocks.count(name), fault == nullptr ? 0U : 1U) << name;
        if (fault != nullptr)
        {
            EXPECT_THAT(blocks.at(name), HasSubstr(fault->reason));
        }
    }
    EXPECT_EQ(records.size(), 160U);
    EXPECT_EQ(Succeed({"list", "--json"}).Json().at("filters").size(), 160U);
    EXPECT_EQ(CountLoads(), onceEach);

    ForgetLoads();
    EXPECT_THAT(Succeed({"scan"}).LastLine(), HasSubstr("nothing to scan, 40 blocked before"));
    EXPECT_TRUE(Loads().empty()) << "nothing has changed";
}

TEST_F(ScanSurvivalTest, AWorkerDoesManyPluginsAndEachFaultCostsOne)
{
    for (const char* name : {"a", "b", "c-segv", "d", "e"})
    {
        AddBundle(name);
    }
    EXPECT_EQ(Succeed({"scan", "--json"}).Json().at("restarts"), 1);
    const std::vector<Load> loads = Loads();
    ASSERT_EQ(loads.size(), 5U);
    EXPECT_EQ(loads[0].process, loads[2].process);
    EXPECT_NE(loads[2].process, loads[3].process);
    EXPECT_EQ(loads[3].process, loads[4].process);
}

TEST_F(ScanSurvivalTest, TellsHowEachWorkerEnded)
{
    const std::map<std::string, std::string> expected = {
        {"a-exit", "exit status 3"},
        {"b-words", "SIGABRT (aborted); it printed: these are my last words"},
        {"c-closes", "disturbed the connection"},
        {"d-writes", "disturbed the connection"},
        {"f-hang", "did not answer for " + Seconds(0.5) + " seconds"},
    };
    AddBundle("e");
    for (const auto& [name, reason] : expected)
    {
        AddBundle(name);
    }
    const RunResult result = Succeed({"scan", "--json", "--timeout", Seconds(0.5)});
    const std::map<std::string, std::string> blocks = Blocks();
    const std::map<std::string, std::string> told = Reasons(result.Json());
    EXPECT_EQ(blocks.size(), expected.size());
    for (const auto& [name, reason] : expected)
    {
        EXPECT_THAT(blocks.at(name), HasSubstr(reason));
        EXPECT_EQ(told.at(name), blocks.at(name));
    }
    EXPECT_THAT(Records(), ElementsAre("e"));
    EXPECT_THAT(result.err, HasSubstr("a-exit.vst3 ended the process"));
}

TEST_F(ScanSurvivalTest, APluginThatTakesTheConnectionsNumberKeepsItsFileToItself)
{
    AddBundle("a-reuses");
    AddBundle("b");
    EXPECT_THAT(States(Succeed({"scan", "--json"}).Json()),
                ElementsAre(Pair("a-reuses", "crashed"), Pair("b", "scanned")));
    EXPECT_THAT(Blocks(), ElementsAre(Pair("a-reuses", HasSubstr("disturbed the connection"))));
    ASSERT_TRUE(std::filesystem::exists(Path("loads.reused")));
    EXPECT_EQ(ReadText(Path("loads.reused")), "");
}

TEST_F(ScanSurvivalTest, AWorkersMemoryIsWrittenNowhere)
{
    AddBundle("a-dumpable");
    EXPECT_THAT(States(Succeed({"scan", "--json"}).Json()), ElementsAre(Pair("a-dumpable", "scanned")));
}

TEST_F(ScanSurvivalTest, WhatIsPrintedIsNoCommandToTheTerminal)
{
    AddBundle("a-colours");
    const RunResult result = Succeed({"scan", "--verbose"});
    EXPECT_THAT(result.err, HasSubstr("red \uFFFD[31m and tabs"));
    EXPECT_THAT(result.err, Not(HasSubstr("\x1B")));
}

TEST_F(ScanSurvivalTest, WhatIsPrintedNeitherBlocksNorDisturbs)
{
    AddBundle("a-prints"); // some megabytes
    AddBundle("b");
    const RunResult silent = Succeed({"scan", "--json"});
    EXPECT_THAT(States(silent.Json()), ElementsAre(Pair("a-prints", "scanned"), Pair("b", "scanned")));
    EXPECT_THAT(silent.err, Not(HasSubstr("chatter")));
    const RunResult shown = Succeed({"scan", "--full", "--verbose"});
    EXPECT_THAT(shown.err, HasSubstr("chatter on the output"));
    EXPECT_THAT(shown.err, HasSubstr("the rest is left out"));
    EXPECT_LT(shown.err.size(), 1U << 20);
    EXPECT_THAT(shown.out, Not(HasSubstr("chatter")));
}

TEST_F(ScanSurvivalTest, ThePluginAtHandIsNotBlamedForAWorkerThatNeverTurnedToIt)
{
    for (const char* name : {"a-deaf", "b", "c"})
    {
        AddBundle(name);
    }
    const nlohmann::json document = Succeed({"scan", "--json"}).Json();
    EXPECT_THAT(States(document), ElementsAre(Pair("a-deaf", "scanned"), Pair("b", "scanned"), Pair("c", "scanned")));
    EXPECT_EQ(document.at("restarts"), 1);
    EXPECT_TRUE(Blocks().empty());
    EXPECT_EQ(CountLoads().at("b"), 1);
}

TEST_F(ScanSurvivalTest, NobodyIsBlamedForAWorkerThatCannotBeStarted)
{
    for (const char* name : {"a-starve", "b", "c"})
    {
        AddBundle(name);
    }
    const RunResult result = Run({"scan"});
    EXPECT_EQ(result.code, 1) << result.err;
    EXPECT_THAT(result.LastLine(), HasSubstr("could not be started"));
    EXPECT_TRUE(Blocks().empty());
    EXPECT_THAT(Records(), ElementsAre("a-starve"));
    Succeed({"scan"});
    EXPECT_THAT(Records(), ElementsAre("a-starve", "b", "c"));
}

TEST_F(ScanSurvivalTest, ThoughTheEndOfChildrenIsIgnoredWhereItWasStarted)
{
    AddBundle("a-segv");
    AddBundle("b");
    std::vector<std::string> words = {"/bin/sh", "-c", "trap '' CHLD; exec \"$0\" \"$@\""};
    const std::vector<std::string> scan = CommandLine({"scan", "--json"});
    words.insert(words.end(), scan.begin(), scan.end());
    const RunResult result = RunProgram(words, mVariables, mFolder);
    ASSERT_EQ(result.code, 0) << result.err;
    EXPECT_THAT(States(result.Json()), ElementsAre(Pair("a-segv", "crashed"), Pair("b", "scanned")));
    EXPECT_THAT(Blocks(), ElementsAre(Pair("a-segv", HasSubstr("SIGSEGV"))));
}

// Where one technology's share of a scan ends, the step into the next must not hit a plug-in that nobody announced.
TEST_F(ScanSurvivalTest, ACrashBehindTheLastOfATechnologyIsNotBlamedOnThat)
{
    const std::filesystem::path folder = mFolder / "vst2";
    std::filesystem::create_directories(folder);
    mVariables["VST_PATH"] = folder.string();
    std::filesystem::copy(VST2Effect("ZebGain2Plain"), folder / "z.so");
    AddBundle("a-segv");
    AddBundle("b");
    EXPECT_THAT(States(Succeed({"scan", "--json"}).Json()),
                ElementsAre(Pair("a-segv", "crashed"), Pair("b", "scanned"), Pair("z", "scanned")));
    EXPECT_THAT(Blocks(), ElementsAre(Pair("a-segv", HasSubstr("SIGSEGV"))));
    std::filesystem::copy(VST2Hazard("CrashInEntry"), folder / "zz.so");
    AddBundle("c");
    EXPECT_EQ(States(Succeed({"scan", "--json"}).Json()).at("zz"), "crashed");
    EXPECT_THAT(Records(), ElementsAre("b", "c"));
    EXPECT_EQ(Blocks().size(), 2U);
}

TEST_F(ScanSurvivalTest, ABundleThatWasNamedDecidesTheExitCode)
{
    AddBundle("a");
    AddBundle("b-segv");
    EXPECT_EQ(Run({"scan", mPlugins.string()}).code, 0);
    Succeed({"unblock", "b-segv"});
    const RunResult named = Run({"scan", Bundle("a").string(), Bundle("b-segv").string(), "--json"});
    EXPECT_EQ(named.code, 5);
    EXPECT_EQ(named.Json().at("error").at("kind"), "crashed");
    EXPECT_EQ(States(named.Json()).at("a"), "scanned");
    EXPECT_THAT(named.LastLine(), HasSubstr("b-segv.vst3 crashed: SIGSEGV (segmentation fault): it is blocked now"));
}

TEST_F(ScanSurvivalTest, InOneProcessACrashEndsTheScanAndTheNextGoesOn)
{
    for (const char* name : {"a", "b-segv", "c"})
    {
        AddBundle(name);
    }
    const RunResult first = Run({"scan", "--in-process"});
    EXPECT_EQ(first.code, 5);
    EXPECT_THAT(first.LastLine(), HasSubstr("b-segv.vst3 crashed"));
    // The next command takes over what the files do not have yet.
    EXPECT_THAT(Blocks(), ElementsAre(Pair("b-segv", HasSubstr("did not end"))));
    EXPECT_THAT(Records(), ElementsAre("a"));
    Succeed({"scan", "--in-process"});
    EXPECT_THAT(Records(), ElementsAre("a", "c"));
    EXPECT_EQ(CountLoads().at("a"), 1);
}

} // namespace

} // namespace zebtest
