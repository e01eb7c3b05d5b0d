#include "module/Module.h"

#include "module/ModuleSteps.h"
#include "utility/ThreadUtils.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <vector>

namespace zebaudiofilterhost
{
namespace
{

using ::testing::ElementsAre;
using ::testing::IsEmpty;

std::vector<std::string> sLog;
bool sThrow = false;

void Log(const std::string& entry)
{
    sLog.push_back(entry);
}

// Added in the wrong order on purpose, as static initializers may come.
const bool sAdded =
    ModuleSteps::GetInstance().Add(
        ModuleStepOrder::kConsoleCommands, [] { Log("commands"); }, [] { Log("no commands"); }) &&
    ModuleSteps::GetInstance().Add(ModuleStepOrder::kDeferredDescriptors,
                                   []
                                   {
                                       if (sThrow)
                                           throw std::runtime_error("refused");
                                       Log(CurrentThreadIDIsMainThreadID() ? "descriptors" : "no main thread");
                                   }) &&
    ModuleSteps::GetInstance().Add(
        ModuleStepOrder::kConsoleCommands, [] { Log("more commands"); }, [] { Log("no more commands"); });

class ModuleTest : public ::testing::Test
{
protected:
    ModuleTest() { sLog.clear(); }
};

TEST_F(ModuleTest, StepsRunAtTheFirstInitializeAndTheLastTerminateOnly)
{
    EXPECT_TRUE(Initialize());
    EXPECT_THAT(sLog, ElementsAre("descriptors", "commands", "more commands"));
    sLog.clear();
    EXPECT_TRUE(Initialize());
    Terminate();
    EXPECT_THAT(sLog, IsEmpty());
    Terminate();
    EXPECT_THAT(sLog, ElementsAre("no more commands", "no commands"));
}

TEST_F(ModuleTest, ALaterInitializeRunsAllStepsAgain)
{
    for (int round = 0; round < 2; ++round)
    {
        sLog.clear();
        Initialize();
        Terminate();
        EXPECT_EQ(sLog.size(), 5U);
    }
}

TEST_F(ModuleTest, ATerminateTooManyWrapsTheCount)
{
    Terminate();
    EXPECT_THAT(sLog, IsEmpty());
    Initialize(); // Back to a count of 0
    EXPECT_THAT(sLog, IsEmpty());
    Initialize();
    EXPECT_EQ(sLog.size(), 3U);
    Terminate();
}

TEST_F(ModuleTest, AStepThatThrowsLeavesTheLibraryUninitialized)
{
    sThrow = true;
    EXPECT_THROW(Initialize(), std::runtime_error);
    sThrow = false;
    Initialize();
    EXPECT_EQ(sLog.size(), 3U);
    Terminate();
}

} // namespace
} // namespace zebaudiofilterhost
