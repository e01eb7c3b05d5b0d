#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <thread>

namespace zebaudiofilterhost
{
namespace
{

// Asked before anything can have told which thread is the main one.
const bool sWasMainThreadAtLoad = CurrentThreadIDIsMainThreadID();
const auto sMainThreadIDAtLoad = GetMainThreadID();

TEST(ThreadUtils, NoThreadIsTheMainThreadBeforeItIsTold)
{
    EXPECT_FALSE(sWasMainThreadAtLoad);
    EXPECT_EQ(sMainThreadIDAtLoad, 0U);
}

TEST(ThreadUtils, OnlyTheTellingThreadIsTheMainThread)
{
    InitializeMainThreadID();
    EXPECT_TRUE(CurrentThreadIDIsMainThreadID());
    bool otherIsMain = true;
    std::thread([&otherIsMain] { otherIsMain = CurrentThreadIDIsMainThreadID(); }).join();
    EXPECT_FALSE(otherIsMain);
}

} // namespace
} // namespace zebaudiofilterhost
