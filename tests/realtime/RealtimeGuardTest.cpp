// Each net of the guard reports a planted violation, and nothing else.
#include "tests/realtime/Plants.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

namespace realtimeguard
{
namespace
{

TEST(RealtimeGuard, EachNetReportsItsPlant)
{
    int seen = 0;
    for (const Plant& plant : Plants())
    {
        if (!CanSee(plant.violation))
            continue;
        Reset();
        {
            const UsageSection usage;
            const Section section;
            plant.act();
        }
        EXPECT_GT(Count(plant.violation), 0U) << plant.name;
        ++seen;
    }
    Reset();
    if (seen == 0)
        GTEST_SKIP() << "no net of the guard works in this build";
}

TEST(RealtimeGuard, NothingIsReportedOutsideSectionsOrForInnocentWork)
{
    PrepareProcess();
    PrepareThread();
    Reset();
    for (const Plant& plant : Plants())
        plant.act();
    int sum = 0;
    {
        const UsageSection usage;
        const Section section;
        const Section nested;
        for (int i = 0; i < 100; ++i)
            sum += i;
    }
    EXPECT_EQ(sum, 4950);
    EXPECT_EQ(CountAll(), 0U) << Report();
}

TEST(RealtimeGuard, OtherThreadsAreNotWatched)
{
    Reset();
    std::atomic<bool> go{false};
    std::atomic<bool> done{false};
    std::thread other(
        [&]
        {
            while (!go.load())
                std::this_thread::yield();
            for (const Plant& plant : Plants())
                plant.act();
            done = true;
        });
    PrepareThread();
    {
        const UsageSection usage;
        const Section section;
        go = true;
        while (!done.load())
        {
        }
    }
    other.join();
    EXPECT_EQ(CountAll(), 0U) << Report();
}

} // namespace
} // namespace realtimeguard
