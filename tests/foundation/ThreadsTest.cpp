#include "foundation/zebcore/Threads.h"

#include <gtest/gtest.h>

#include <thread>

using zebcore::threads::GetCurrentThreadID;
using zebcore::threads::ThreadID;

namespace
{

TEST(ThreadID, IsStableAndNeverZero)
{
    EXPECT_NE(0U, GetCurrentThreadID());
    EXPECT_EQ(GetCurrentThreadID(), GetCurrentThreadID());
}

TEST(ThreadID, DiffersBetweenThreadsThatLiveTogether)
{
    ThreadID other = 0;
    std::thread([&] { other = GetCurrentThreadID(); }).join();
    EXPECT_NE(0U, other);
    EXPECT_NE(GetCurrentThreadID(), other);
}

} // namespace
