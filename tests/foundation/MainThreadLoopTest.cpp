#include "foundation/zebcore/MainThreadLoop.h"

#include "foundation/zebcore/Threads.h"

#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

using namespace zebcore::threads;

namespace
{

/// Pumps with a clock that moves only when told.
class MainThreadLoopTest : public testing::Test
{
protected:
    MainThreadLoopTest()
    {
        SetMainThreadClock([this] { return mMillis * 1'000'000ULL; });
    }
    ~MainThreadLoopTest() override
    {
        for (const WatchID timer : mTimers)
            RemoveTimerWatch(timer);
        SetMainThreadClock({});
    }

    void Call(char name, unsigned int delay)
    {
        AsyncCallFromMainThread([this, name] { mRan += name; }, delay);
    }
    WatchID Timer(char name, unsigned int period)
    {
        mTimers.push_back(AddTimerWatch(period, [this, name] { mRan += name; }));
        return mTimers.back();
    }
    /// What ran at that time.
    std::string RanAt(unsigned long long millis)
    {
        mMillis = millis;
        mRan.clear();
        PumpMainThread();
        return mRan;
    }

    unsigned long long mMillis = 1000;
    std::string mRan;
    std::vector<WatchID> mTimers;
};

TEST_F(MainThreadLoopTest, CallsRunOnceWhenDueAndInOrder)
{
    Call('c', 20);
    Call('a', 0);
    Call('d', 20);
    Call('b', 10);
    EXPECT_EQ("a", RanAt(1000));
    EXPECT_EQ("", RanAt(1009));
    EXPECT_EQ("b", RanAt(1010));
    EXPECT_EQ("", RanAt(1019));
    EXPECT_EQ("cd", RanAt(5000));
    EXPECT_EQ("", RanAt(9000));
}

TEST_F(MainThreadLoopTest, PumpTellsWhetherSomethingRan)
{
    EXPECT_FALSE(PumpMainThread());
    Call('a', 0);
    EXPECT_TRUE(PumpMainThread());
    EXPECT_FALSE(PumpMainThread());
}

TEST_F(MainThreadLoopTest, ACallThatQueuesItselfDoesNotHoldThePump)
{
    int runs = 0;
    boost::function<void()> again = [&]
    {
        if (++runs < 5)
            AsyncCallFromMainThread(again, 0);
    };
    again();
    for (int expected = 2; expected <= 5; ++expected)
    {
        PumpMainThread();
        EXPECT_EQ(expected, runs);
    }
}

TEST_F(MainThreadLoopTest, TimersRepeatInPhaseAndSkipWhatTheyMissed)
{
    Timer('t', 10);
    EXPECT_EQ("", RanAt(1009));
    EXPECT_EQ("t", RanAt(1010));
    EXPECT_EQ("", RanAt(1019));
    EXPECT_EQ("t", RanAt(1057)) << "once, however late";
    EXPECT_EQ("", RanAt(1059));
    EXPECT_EQ("t", RanAt(1060)) << "still on multiples of the period";
}

TEST_F(MainThreadLoopTest, APeriodOfZeroIsAMillisecond)
{
    Timer('t', 0);
    EXPECT_EQ("", RanAt(1000));
    EXPECT_EQ("t", RanAt(1001));
}

TEST_F(MainThreadLoopTest, ARemovedTimerStaysSilent)
{
    const WatchID removed = Timer('r', 10);
    Timer('t', 10);
    EXPECT_EQ("rt", RanAt(1010));
    RemoveTimerWatch(removed);
    RemoveTimerWatch(removed);
    RemoveTimerWatch(kNoWatch);
    EXPECT_EQ("t", RanAt(1020));
}

TEST_F(MainThreadLoopTest, TimersMayBeRemovedFromInsideATimer)
{
    const auto payload = std::make_shared<int>(0);
    WatchID self = kNoWatch;
    WatchID other = kNoWatch;
    self = AddTimerWatch(10,
                         [&, payload]
                         {
                             RemoveTimerWatch(self);
                             RemoveTimerWatch(other);
                             ++*payload; // Still there, although its watch has gone.
                         });
    other = AddTimerWatch(10, [&] { FAIL() << "was removed before its turn"; });
    RanAt(1010);
    RanAt(1020);
    EXPECT_EQ(1, *payload);
    EXPECT_EQ(1, payload.use_count()) << "its handler has been let go";
}

TEST_F(MainThreadLoopTest, ATimerIsNotEnteredTwice)
{
    int depth = 0;
    int deepest = 0;
    Timer('t', 10);
    mTimers.push_back(AddTimerWatch(10,
                                    [&]
                                    {
                                        deepest = std::max(deepest, ++depth);
                                        mMillis += 50;
                                        PumpMainThread();
                                        --depth;
                                    }));
    EXPECT_EQ("tt", RanAt(1010)) << "others go on inside a nested pump";
    EXPECT_EQ(1, deepest);
}

TEST_F(MainThreadLoopTest, AnExceptionLosesNothingOfTheQueue)
{
    Call('a', 0);
    AsyncCallFromMainThread([] { throw std::runtime_error("handler"); }, 0);
    Call('b', 0);
    EXPECT_THROW(PumpMainThread(), std::runtime_error);
    EXPECT_EQ("a", mRan);
    EXPECT_EQ("b", RanAt(1000));
}

TEST_F(MainThreadLoopTest, ATimerThatThrowsGoesOn)
{
    int runs = 0;
    mTimers.push_back(AddTimerWatch(10,
                                    [&]
                                    {
                                        ++runs;
                                        throw std::runtime_error("timer");
                                    }));
    for (const unsigned long long millis : {1010ULL, 1020ULL})
        EXPECT_THROW(RanAt(millis), std::runtime_error);
    EXPECT_EQ(2, runs);
}

TEST_F(MainThreadLoopTest, ANestedPumpRunsWhatTheOuterHasNot)
{
    AsyncCallFromMainThread(
        [&]
        {
            mRan += '(';
            PumpMainThread();
            mRan += ')';
        },
        0);
    Call('a', 0);
    Call('b', 0);
    EXPECT_EQ("(ab)", RanAt(1000));
}

TEST_F(MainThreadLoopTest, AChangeOfClockKeepsTheTimeToWait)
{
    Call('a', 30);
    mMillis += 10;
    // Shared, since the clock is asked once more when the fixture puts the real one back.
    const auto other = std::make_shared<unsigned long long>(500);
    SetMainThreadClock([other] { return *other * 1'000'000ULL; });
    *other = 519;
    EXPECT_FALSE(PumpMainThread());
    *other = 520;
    EXPECT_TRUE(PumpMainThread());
    EXPECT_EQ("a", mRan);
}

TEST_F(MainThreadLoopTest, RunUntilStopsWhenDoneOrOutOfTime)
{
    Call('a', 5);
    const auto tick = [&]
    {
        return mMillis++ * 1'000'000ULL;
    };
    SetMainThreadClock(tick);
    EXPECT_TRUE(RunMainThreadUntil([&] { return mRan == "a"; }, 1000));
    const unsigned long long before = mMillis;
    EXPECT_FALSE(RunMainThreadUntil([] { return false; }, 50));
    EXPECT_GE(mMillis, before + 50);
    EXPECT_FALSE(RunMainThreadUntil({}, 50));
}

TEST_F(MainThreadLoopTest, RunUntilPumpsAtLeastOnce)
{
    Call('a', 0);
    EXPECT_TRUE(RunMainThreadUntil([] { return true; }, 0));
    EXPECT_EQ("a", mRan);
}

TEST(MainThreadLoopThreads, CallsFromManyThreadsAllRunHere)
{
    constexpr int kThreads = 4;
    constexpr int kCalls = 250;
    const ThreadID here = GetCurrentThreadID();
    int ran = 0; // No atomic: the calls run on one thread.
    int elsewhere = 0;
    std::vector<std::thread> threads;
    threads.reserve(kThreads);
    for (int i = 0; i < kThreads; ++i)
        threads.emplace_back(
            [&]
            {
                for (int call = 0; call < kCalls; ++call)
                    AsyncCallFromMainThread(
                        [&]
                        {
                            ++ran;
                            elsewhere += GetCurrentThreadID() == here ? 0 : 1;
                        },
                        0);
            });
    EXPECT_TRUE(RunMainThreadUntil([&] { return ran == kThreads * kCalls; }, 60'000));
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(0, elsewhere);
}

TEST(MainThreadLoopThreads, ACallWakesAWaitingMainThread)
{
    // A ball that goes to another thread and back. A main thread that slept through its return would see it only when
    // it looks up by itself, and would be far too slow.
    constexpr int kTrips = 500;
    constexpr unsigned int kTimeoutMs = 5000;
    std::atomic<int> served{0};
    int returned = 0;
    std::thread other(
        [&]
        {
            for (int trip = 0; trip < kTrips; ++trip)
            {
                served.wait(trip);
                AsyncCallFromMainThread([&] { ++returned; }, 0);
            }
        });
    const auto serve = [&]
    {
        if (served <= returned && served < kTrips)
        {
            ++served;
            served.notify_one();
        }
        return returned == kTrips;
    };
    EXPECT_TRUE(RunMainThreadUntil(serve, kTimeoutMs));
    served = kTrips;
    served.notify_one();
    other.join();
    RunMainThreadUntil([&] { return returned == kTrips; }, kTimeoutMs);
}

} // namespace
