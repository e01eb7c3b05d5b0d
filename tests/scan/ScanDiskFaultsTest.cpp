#include "tests/scan/support/ScanFolder.h"

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::HasSubstr;

struct DiskFault
{
    const char* call;
    const char* what;
};

constexpr DiskFault kFaults[] = {{"write", "full"},    {"write", "shortThenFull"}, {"sync", "broken"},
                                 {"rename", "broken"}, {"rename", "full"},         {"rename", "refused"}};

constexpr const char* kCatalogue = "AudioPluginManagerSettings.xml";
constexpr const char* kBinaries = "AudioPluginManagerSettings.binaries.json";
constexpr const char* kBlocks = "DynamicAudioPlugInBlacklist.xml";
constexpr const char* kReasons = "DynamicAudioPlugInBlacklist.reasons.json";
constexpr const char* kJournal = "AudioPluginManagerSettings.journal";

class ScanDiskFaultsTest : public ScanFolder
{
protected:
    ScanDiskFaultsTest()
    {
        for (const char* name : {"a", "b-segv", "c", "d-abort"})
        {
            AddBundle(name);
        }
        StartAnew();
    }

    // One plug-in in the catalogue, one blocked, and two that are to be scanned.
    void StartAnew() const
    {
        fs::remove_all(Settings());
        Run({"scan", "--quiet", Bundle("a").string(), Bundle("b-segv").string()});
    }

    RunResult RunOnFaultyDisk(const std::string& fault, const std::vector<std::string>& arguments)
    {
        std::vector<std::string> words = CommandLine(arguments);
        words.front() = ZEBHOST_ON_FAULTY_DISK;
        std::map<std::string, std::string> variables = mVariables;
        variables["ZEB_FAULT"] = fault;
        return RunProgram(words, variables, mFolder);
    }

    // Every file is whole, and holds all that was in it before.
    void ExpectNothingLost(const std::string& fault) const
    {
        const RunResult list = Succeed({"list", "--json"});
        EXPECT_THAT(list.err, testing::Not(HasSubstr("damaged"))) << fault;
        EXPECT_EQ(Records().count("a"), 1U) << fault;
        EXPECT_THAT(Blocks()["b-segv"], HasSubstr("SIGSEGV")) << fault;
        for (const char* file : {kBinaries, kReasons})
        {
            EXPECT_FALSE(nlohmann::json::parse(ReadText(Settings() / file), nullptr, false).is_discarded())
                << fault << file;
        }
        for (const fs::directory_entry& entry : fs::directory_iterator(Settings()))
        {
            const std::string name = entry.path().filename();
            EXPECT_TRUE(name == kCatalogue || name == kBinaries || name == kBlocks || name == kReasons)
                << fault << " left " << name;
        }
    }
};

TEST_F(ScanDiskFaultsTest, TheUserIsToldWhichFileAndNothingIsLost)
{
    for (const char* file : {kCatalogue, kBinaries, kBlocks, kReasons})
    {
        for (const DiskFault& each : kFaults)
        {
            const std::string fault = std::string(each.call) + ":" + each.what + ":" + file;
            const RunResult result = RunOnFaultyDisk(fault, {"scan", "--json"});
            EXPECT_EQ(result.code, 7) << fault << result.err;
            EXPECT_THAT(result.LastLine(), HasSubstr((Settings() / file).string())) << fault;
            EXPECT_THAT(result.LastLine(), HasSubstr("--settings")) << fault;
            EXPECT_EQ(result.Json().at("error").at("kind"), "file") << fault;
            ExpectNothingLost(fault);
            StartAnew();
        }
    }
}

// Whichever save is the first to fail, and with known plug-ins as with new ones.
TEST_F(ScanDiskFaultsTest, NoGoodPluginIsBlockedByATroubledDisk)
{
    const std::string faults[] = {"rename:full:", "write:full:", "sync:broken:"};
    for (const char* file : {kCatalogue, kBinaries, kBlocks, kReasons, "$/settings"})
    {
        for (int step = 0; step < 12; ++step)
        {
            const std::string fault = faults[step % 3] + std::to_string(step / 3) + "+" + file;
            RunOnFaultyDisk(fault, {"scan", "--full", Bundle("a").string(), Bundle("c").string()});
            EXPECT_THAT(Blocks(), testing::ElementsAre(testing::Pair("b-segv", HasSubstr("SIGSEGV")))) << fault;
            EXPECT_EQ(Records().count("a"), 1U) << fault;
        }
    }
}

// Whichever of its lines is the first that finds no room, and wherever it is cut short.
TEST_F(ScanDiskFaultsTest, AJournalThatCannotBeWrittenEndsTheScanAndBlocksNothing)
{
    for (const char* fault : {"write:full:", "write:shortThenFull:"})
    {
        for (int lines = 0; lines < 4; ++lines)
        {
            const std::string full = fault + std::to_string(lines) + "+" + kJournal;
            const RunResult result =
                RunOnFaultyDisk(full, {"scan", "--full", Bundle("a").string(), Bundle("c").string()});
            EXPECT_EQ(result.code, 7) << full << result.err;
            EXPECT_THAT(result.LastLine(), HasSubstr((Settings() / kJournal).string())) << full;
            EXPECT_EQ(Blocks().size(), 1U) << full;
            ExpectNothingLost(full);
            EXPECT_EQ(Records().count("c"), 0U) << full;
        }
    }
}

TEST_F(ScanDiskFaultsTest, APresetWithoutRoomIsNoMatterOfPermissions)
{
    for (const auto& [fault, advice] :
         {std::pair("write:full:", "make room"), std::pair("rename:refused:", "writable")})
    {
        const RunResult result = RunOnFaultyDisk(std::string(fault) + "warm.xml",
                                                 {"preset", "save", Bundle("a").string(), Path("warm.xml")});
        EXPECT_EQ(result.code, 7) << fault << result.err;
        EXPECT_THAT(result.LastLine(), testing::AllOf(HasSubstr("warm.xml"), HasSubstr(advice))) << fault;
    }
}

TEST_F(ScanDiskFaultsTest, WithRoomAgainTheNextScanGoesOn)
{
    RunOnFaultyDisk(std::string("write:full:") + kCatalogue, {"scan"});
    Succeed({"scan"});
    EXPECT_THAT(Records(), testing::ElementsAre("a", "c"));
    EXPECT_EQ(Blocks().size(), 2U);
}

TEST_F(ScanDiskFaultsTest, ShortWritesAreCarriedOn)
{
    for (const char* file : {kCatalogue, kBinaries, kBlocks, kReasons, kJournal})
    {
        const std::string fault = std::string("write:short:") + file;
        const RunResult result = RunOnFaultyDisk(fault, {"scan", "--full"});
        EXPECT_EQ(result.code, 0) << fault << result.err;
        ExpectNothingLost(fault);
    }
    EXPECT_THAT(Records(), testing::ElementsAre("a", "c"));
}

TEST_F(ScanDiskFaultsTest, BlockingByHandTellsToo)
{
    for (const char* file : {kBlocks, kReasons})
    {
        for (const DiskFault& each : kFaults)
        {
            const std::string fault = std::string(each.call) + ":" + each.what + ":" + file;
            const RunResult result = RunOnFaultyDisk(fault, {"block", Bundle("a").string()});
            EXPECT_EQ(result.code, 7) << fault << result.err;
            EXPECT_THAT(result.LastLine(), HasSubstr(file)) << fault;
            ExpectNothingLost(fault);
            EXPECT_EQ(Blocks().count("a"), 0U) << fault;
        }
    }
}

} // namespace

} // namespace zebtest
