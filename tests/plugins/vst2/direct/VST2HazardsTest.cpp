// That each VST 2 hazard does the harm it is there for, in a process of its own.
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/vst2/direct/DirectVST2.h"

#include <cstdlib>
#include <filesystem>
#include <gtest/gtest.h>
#include <sys/time.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

using namespace zebtest;
using namespace zebaudiofilterhost::vst;

constexpr int kSurvived = 42;
constexpr int kThrew = 43;
constexpr int kMoved = 44;

// Ends itself after a while, should the plug-in not come back.
[[noreturn]] void UsePlugin(const std::string& name)
{
    const itimerval limit{{0, 0}, {0, 500000}};
    setitimer(ITIMER_REAL, &limit, nullptr);
    const auto folder = std::filesystem::current_path();
    try
    {
        DirectVST2 plugin(VST2Hazard(name));
        while (name == "EndlessShell" && plugin.Text(effShellGetNextPlugin) == "Member")
        {
        }
        plugin.Process({{1.0F}});
    }
    catch (...)
    {
        std::_Exit(kThrew);
    }
    std::_Exit(std::filesystem::current_path() == folder ? kSurvived : kMoved);
}

int StatusAfterUsing(const std::string& name)
{
    const pid_t child = fork();
    if (child == 0)
        UsePlugin(name);
    int status = 0;
    waitpid(child, &status, 0);
    return status;
}

TEST(VST2Hazards, DoNotLetTheirProcessGoOn)
{
    for (const char* name : {"CrashOnLoad", "CrashInEntry", "CrashInOpen", "CrashInProcess", "CrashElsewhere"})
    {
        const int status = StatusAfterUsing(name);
        EXPECT_FALSE(WIFEXITED(status) && WEXITSTATUS(status) == kSurvived) << name;
    }
    for (const char* name : {"HangInEntry", "HangInOpen", "EndlessShell"})
    {
        const int status = StatusAfterUsing(name);
        EXPECT_TRUE(WIFSIGNALED(status) && WTERMSIG(status) == SIGALRM) << name;
    }
    EXPECT_EQ(WEXITSTATUS(StatusAfterUsing("ThrowInEntry")), kThrew);
    EXPECT_EQ(WEXITSTATUS(StatusAfterUsing("ChangesFolder")), kMoved);
}

} // namespace
