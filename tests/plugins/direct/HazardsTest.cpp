// That each hazard does the harm it is there for, in a process of its own.
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/direct/DirectPlugin.h"

#include <cstdlib>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/time.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

using namespace zebtest;

constexpr int kSurvived = 42;
constexpr int kThrew = 43;

// Ends itself after a while, should the bundle not come back.
[[noreturn]] void UseBundle(const std::string& name, int output)
{
    dup2(output, STDOUT_FILENO);
    dup2(output, STDERR_FILENO);
    const itimerval limit{{0, 0}, {0, 700000}};
    setitimer(ITIMER_REAL, &limit, nullptr);
    try
    {
        const DirectPlugin plugin(HazardBundle(name));
    }
    catch (...)
    {
        std::_Exit(kThrew);
    }
    if (name == "CrashAtExit")
        std::exit(kSurvived);
    std::_Exit(kSurvived);
}

// The status that waitpid gives.
int StatusAfterUsing(const std::string& name, int output)
{
    const pid_t child = fork();
    if (child == 0)
        UseBundle(name, output);
    int status = 0;
    waitpid(child, &status, 0);
    return status;
}

bool Exited(int status, int code)
{
    return WIFEXITED(status) && WEXITSTATUS(status) == code;
}

class Hazard : public testing::TestWithParam<const char*>
{
};

TEST_P(Hazard, DoesNotLetItsProcessGoOn)
{
    const int nowhere = open("/dev/null", O_WRONLY | O_CLOEXEC);
    const int status = StatusAfterUsing(GetParam(), nowhere);
    close(nowhere);
    EXPECT_FALSE(Exited(status, kSurvived));
    EXPECT_FALSE(Exited(status, kThrew));
    EXPECT_EQ(Exited(status, 0), std::string(GetParam()) == "ExitInEntry");
}

INSTANTIATE_TEST_SUITE_P(All, Hazard,
                         testing::Values("CrashOnLoad", "CrashInEntry", "AbortInEntry", "ExitInEntry", "HangInEntry",
                                         "ChatterInEntry", "CrashInGetPluginFactory", "CrashOnCreate",
                                         "CrashOnInitialize", "HangOnInitialize", "CrashAtExit"));

TEST(Hazards, ThatThrowReachTheirCaller)
{
    EXPECT_TRUE(Exited(StatusAfterUsing("ThrowInEntry", STDERR_FILENO), kThrew));
    EXPECT_TRUE(Exited(StatusAfterUsing("ThrowOnCreate", STDERR_FILENO), kThrew));
}

TEST(Hazards, ChatterFillsAnyPipe)
{
    int ends[2];
    ASSERT_EQ(pipe2(ends, O_CLOEXEC), 0);
    const pid_t child = fork();
    if (child == 0)
        UseBundle("ChatterInEntry", ends[1]);
    close(ends[1]);
    std::size_t total = 0;
    std::vector<char> buffer(4096);
    while (total < 100000)
    {
        const ssize_t count = read(ends[0], buffer.data(), buffer.size());
        ASSERT_GT(count, 0);
        total += static_cast<std::size_t>(count);
    }
    kill(child, SIGKILL);
    waitpid(child, nullptr, 0);
    close(ends[0]);
}

} // namespace
