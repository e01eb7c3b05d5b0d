// Each net of the guard reports a planted violation.
#include "tests/support/RealtimeGuard.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <functional>
#include <memory>
#include <mutex>
#include <shared_mutex>
#include <string>
#include <thread>
#include <unistd.h>
#include <vector>

namespace realtimeguard
{
namespace
{

struct Plant
{
    std::string name;
    Violation violation;
    std::function<void()> act;
};

void* volatile sKept = nullptr; // Keeps the compiler from leaving an allocation out
std::mutex sMutex;
std::shared_mutex sSharedMutex;

std::vector<Plant> Plants()
{
    return {
        {"malloc", Violation::Allocation,
         []
         {
             sKept = std::malloc(100);
         }},
        {"free", Violation::Free,
         []
         {
             std::free(sKept);
         }},
        {"aligned new", Violation::Allocation,
         []
         {
             struct alignas(64) Aligned
             {
                 char bytes[64];
             };
             const auto made = std::make_unique<Aligned>();
             sKept = made.get();
         }},
        {"vector", Violation::Allocation,
         []
         {
             sKept = std::vector<int>(1000).data();
         }},
        {"string", Violation::Free,
         []
         {
             sKept = std::string(100, 'x').data();
         }},
        {"mutex", Violation::Lock,
         []
         {
             const std::lock_guard<std::mutex> lock(sMutex);
         }},
        {"try_lock", Violation::Lock,
         []
         {
             if (sMutex.try_lock())
                 sMutex.unlock();
         }},
        {"shared mutex", Violation::Lock,
         []
         {
             const std::shared_lock<std::shared_mutex> lock(sSharedMutex);
         }},
        {"write", Violation::SystemCall,
         []
         {
             sKept = ::write(-1, "", 0) < 0 ? nullptr : sKept;
         }},
        {"yield", Violation::SystemCall,
         []
         {
             std::this_thread::yield();
         }},
    };
}

bool CanSee(Violation violation)
{
    AnnounceWhatIsMissing();
    return violation == Violation::SystemCall ? CatchesSystemCalls() : IsActive();
}

TEST(RealtimeGuard, EachNetReportsItsPlant)
{
    int seen = 0;
    for (const Plant& plant : Plants())
    {
        if (!CanSee(plant.violation))
            continue;
        Reset();
        {
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
    Reset();
    for (const Plant& plant : Plants())
        plant.act();
    int sum = 0;
    {
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
    {
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
