#include "tests/scan/support/ScanFolder.h"
#include "tests/scan/support/StartedProgram.h"

#include <csignal>

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Pair;

// Scans that somebody ends from outside.
class ScanInterruptTest : public ScanFolder
{
protected:
    ScanInterruptTest()
    {
        AddBundle("a");
        AddBundle("c");
    }

    // The worker that has loaded a plug-in of this name; 0 if none has within a minute.
    pid_t WorkerThatLoads(const std::string& name) const
    {
        pid_t worker = 0;
        Eventually(
            [this, &name, &worker]
            {
                for (const Load& load : Loads())
                {
                    worker = load.name == name ? load.process : worker;
                }
                return worker != 0;
            });
        return worker;
    }

    StartedProgram Start(const std::vector<std::string>& arguments) const
    {
        return {CommandLine(arguments), mVariables, mFolder};
    }

    // Starts the command while the settings are empty and locked, and fills them once it has turned to them.
    int RunWhileFilesAppear(const std::vector<std::string>& command, const fs::path& files) const
    {
        fs::remove_all(Settings());
        fs::create_directories(Settings());
        const int folder = open(Settings().c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
        EXPECT_EQ(flock(folder, LOCK_EX), 0);
        StartedProgram program = Start(command);
        EXPECT_TRUE(Eventually([this, &program] { return HasOpen(program.Process(), Settings()); }));
        fs::copy(files, Settings(), fs::copy_options::recursive);
        close(folder);
        return program.Wait();
    }

    static bool HasOpen(pid_t process, const fs::path& path)
    {
        std::error_code gone;
        for (const fs::directory_entry& each :
             fs::directory_iterator("/proc/" + std::to_string(process) + "/fd", gone))
        {
            if (fs::read_symlink(each, gone) == path)
            {
                return true;
            }
        }
        return !IsAlive(process);
    }
};

TEST_F(ScanInterruptTest, CtrlCKeepsWhatIsDoneAndBlocksNothing)
{
    AddBundle("b-hang");
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT})
    {
        StartedProgram scan = Start({"scan", "--json"});
        const pid_t worker = WorkerThatLoads("b-hang");
        // A second one changes nothing.
        scan.SignalGroup(signal);
        scan.SignalGroup(signal);
        EXPECT_EQ(scan.Wait(), 1);
        EXPECT_THAT(scan.Err(), HasSubstr("the scan was interrupted after"));
        EXPECT_THAT(scan.Err(), HasSubstr("run it again to go on"));
        EXPECT_EQ(nlohmann::json::parse(scan.Out()).at("error").at("kind"), "job-failed");
        EXPECT_THAT(Blocks(), IsEmpty());
        EXPECT_THAT(Records(), ElementsAre("a"));
        EXPECT_FALSE(IsAlive(worker));
        ForgetLoads();
    }
}

TEST_F(ScanInterruptTest, UnderNohupAHangUpChangesNothing)
{
    AddBundle("b-hang");
    std::vector<std::string> words = {"/bin/sh", "-c", "trap '' HUP; exec \"$0\" \"$@\""};
    const std::vector<std::string> command = CommandLine({"scan", "--timeout", Seconds(1)});
    words.insert(words.end(), command.begin(), command.end());
    StartedProgram scan(words, mVariables, mFolder);
    WorkerThatLoads("b-hang");
    scan.Signal(SIGHUP);
    EXPECT_EQ(scan.Wait(), 0) << scan.Err();
    EXPECT_THAT(Records(), ElementsAre("a", "c"));
}

TEST_F(ScanInterruptTest, AnInterruptedRetryLeavesThePluginBlockedAsItWas)
{
    AddBundle("b-hang");
    Succeed({"scan", "--timeout", Seconds(1)});
    const auto before = Blocks();
    EXPECT_THAT(before, ElementsAre(Pair("b-hang", HasSubstr("did not answer"))));
    ForgetLoads();
    StartedProgram scan = Start({"scan", "--retry-blocked"});
    WorkerThatLoads("b-hang");
    scan.Signal(SIGINT);
    EXPECT_EQ(scan.Wait(), 1);
    EXPECT_EQ(Blocks(), before);
}

TEST_F(ScanInterruptTest, EndingAWorkerByHandSkipsThePluginAndBlocksNothing)
{
    AddBundle("b-hang");
    StartedProgram scan = Start({"scan"});
    kill(WorkerThatLoads("b-hang"), SIGTERM);
    EXPECT_EQ(scan.Wait(), 0) << scan.Err();
    EXPECT_THAT(scan.Err(), HasSubstr("1 interrupted"));
    EXPECT_THAT(Blocks(), IsEmpty());
    EXPECT_THAT(Records(), ElementsAre("a", "c"));
}

TEST_F(ScanInterruptTest, AKilledWorkerIsReplacedAndItsPluginBlocked)
{
    AddBundle("b-hang");
    StartedProgram scan = Start({"scan"});
    kill(WorkerThatLoads("b-hang"), SIGKILL);
    EXPECT_EQ(scan.Wait(), 0) << scan.Err();
    EXPECT_THAT(Blocks(), ElementsAre(Pair("b-hang", HasSubstr("SIGKILL"))));
    EXPECT_THAT(Records(), ElementsAre("a", "c"));
}

TEST_F(ScanInterruptTest, AHangTakesItsChildrenAlong)
{
    AddBundle("b-spawn");
    const RunResult result = Succeed({"scan", "--timeout", Seconds(1)});
    EXPECT_THAT(Records(), ElementsAre("a", "c"));
    pid_t child = 0;
    for (const Load& load : Loads())
    {
        child = load.name == "child" ? load.process : child;
    }
    ASSERT_GT(child, 0);
    EXPECT_TRUE(Eventually([child] { return !IsAlive(child); }));
}

TEST_F(ScanInterruptTest, AHangOutsideItsProcessGroupEndsToo)
{
    AddBundle("b-leave");
    StartedProgram scan = Start({"scan", "--timeout", Seconds(0.5)});
    const pid_t worker = WorkerThatLoads("b-leave");
    ASSERT_TRUE(Eventually([worker] { return !IsAlive(worker); }));
    EXPECT_EQ(scan.Wait(), 0) << scan.Err();
    EXPECT_THAT(Records(), ElementsAre("a", "c"));
    EXPECT_THAT(Blocks(), ElementsAre(Pair("b-leave", HasSubstr("did not answer"))));
}

TEST_F(ScanInterruptTest, AWorkerDiesWithItsParent)
{
    AddBundle("b-hang");
    StartedProgram scan = Start({"scan"});
    const pid_t worker = WorkerThatLoads("b-hang");
    scan.Signal(SIGKILL);
    EXPECT_EQ(scan.Wait(), -SIGKILL);
    EXPECT_TRUE(Eventually([worker] { return !IsAlive(worker); }));
    EXPECT_THAT(Blocks(), ElementsAre(Pair("b-hang", "at hand in a scan that did not end")));
    Succeed({"scan"});
    EXPECT_THAT(Records(), ElementsAre("a", "c"));
    EXPECT_EQ(CountLoads().at("b-hang"), 1);
}

TEST_F(ScanInterruptTest, NobodyElseChangesTheSettingsMeanwhile)
{
    AddBundle("b-hang");
    StartedProgram scan = Start({"scan"});
    WorkerThatLoads("b-hang");
    const std::vector<std::string> commands[] = {
        {"scan"}, {"block", Bundle("c").string()}, {"unblock", Bundle("b-hang").string()}};
    for (const std::vector<std::string>& command : commands)
    {
        const RunResult result = Run(command);
        EXPECT_EQ(result.code, 1) << command.front();
        EXPECT_THAT(result.LastLine(), HasSubstr("another scan is at work in " + Settings().string()));
    }
    EXPECT_THAT(Succeed({"list", "--names"}).out, "a\n");
    Succeed({"scan", "--dry-run"});
    scan.Signal(SIGINT);
    EXPECT_EQ(scan.Wait(), 1);
    Succeed({"block", Bundle("c").string()});
}

// The files change between the start of a command and the moment at which it may change them itself.
TEST_F(ScanInterruptTest, WhatAnotherProgramSavedMeanwhileIsKept)
{
    AddBundle("b");
    AddBundle("d");
    const fs::path saved = mFolder / "saved";
    Succeed({"scan", Bundle("a").string()});
    Succeed({"block", Bundle("d").string()});
    fs::rename(Settings(), saved);
    const std::vector<std::string> commands[] = {{"scan", Bundle("b").string()}, {"block", Bundle("b").string()}};
    for (const std::vector<std::string>& command : commands)
    {
        // A machine so slow that the command gives up waiting proves nothing.
        int code = 1;
        for (int tries = 0; code == 1 && tries < 20; ++tries)
        {
            code = RunWhileFilesAppear(command, saved);
        }
        EXPECT_EQ(code, 0) << command.front();
        EXPECT_EQ(Records().count("a"), 1U) << command.front();
        EXPECT_EQ(Blocks().count("d"), 1U) << command.front();
        EXPECT_EQ(Records().count("b") + Blocks().count("b"), 1U) << command.front();
    }
}

// Ctrl-Z and a lid that is closed must not count as a plug-in's silence.
TEST_F(ScanInterruptTest, AStoppedScanBlamesNobody)
{
    AddBundle("b-hang");
    StartedProgram scan = Start({"scan", "--timeout", Seconds(2)});
    WorkerThatLoads("b-hang");
    scan.Signal(SIGSTOP);
    const auto longer = std::chrono::steady_clock::now() + std::chrono::duration<double>(2.5 * Slowness());
    Eventually([longer] { return std::chrono::steady_clock::now() > longer; });
    scan.Signal(SIGCONT);
    scan.Signal(SIGINT);
    EXPECT_EQ(scan.Wait(), 1);
    EXPECT_THAT(Blocks(), IsEmpty());
}

} // namespace

} // namespace zebtest
