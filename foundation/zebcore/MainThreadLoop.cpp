#include "foundation/zebcore/MainThreadLoop.h"

#include "foundation/zebcore/Threads.h"
#include "foundation/zebcore/internal/DescriptorPoller.h"
#include "foundation/zebcore/internal/DescriptorWatches.h"
#include "foundation/zebcore/internal/MainThreadQueue.h"

#include <algorithm>
#include <chrono>
#include <utility>

namespace zebcore::threads
{

namespace
{

using Nanos = MainThreadQueue::Nanos;

constexpr Nanos kNanosPerMilli = 1'000'000;
/// So that a condition that another thread fulfils without a word is seen too.
constexpr Nanos kLongestWait = 20 * kNanosPerMilli;

struct Loop
{
    MainThreadQueue mQueue;
    DescriptorPoller mPoller{[this](int descriptor)
                             {
                                 mWatches.OnReady(descriptor);
                             }};
    DescriptorWatches mWatches{mPoller};
};

Loop& GetLoop()
{
    // Never destroyed: what is still queued at exit may belong to libraries that are gone by then.
    static Loop& loop = *new Loop;
    return loop;
}

void Wait(Loop& loop, Nanos longest)
{
    if (loop.mQueue.HasOwnClock() || loop.mWatches.HasTurns())
        longest = 0;
    const Nanos untilNext = loop.mQueue.NanosUntilNext().value_or(longest);
    loop.mPoller.Wait(std::chrono::nanoseconds(std::min({longest, untilNext, kLongestWait})));
}

} // namespace

void ScheduleNextPump()
{
    Loop& loop = GetLoop();
    if (const auto untilNext = loop.mQueue.NanosUntilNext())
        loop.mPoller.Wake(std::chrono::nanoseconds(*untilNext));
}

void PumpInsideSystemLoop()
{
    Loop& loop = GetLoop();
    loop.mQueue.RunDue();
    loop.mWatches.RunTurns();
}

void AsyncCallFromMainThread(boost::function<void()> function, unsigned int delayMs)
{
    GetLoop().mQueue.AddCall(std::move(function), delayMs * kNanosPerMilli);
    ScheduleNextPump();
}

bool PumpMainThread()
{
    Loop& loop = GetLoop();
    const bool ranCalls = loop.mQueue.RunDue();
    loop.mPoller.Poll();
    const bool ranHandlers = loop.mWatches.RunTurns();
    return ranCalls || ranHandlers;
}

bool RunMainThreadUntil(const boost::function<bool()>& done, unsigned int timeoutMs)
{
    Loop& loop = GetLoop();
    const Nanos deadline = loop.mQueue.Now() + timeoutMs * kNanosPerMilli;
    for (;;)
    {
        PumpMainThread();
        if (done && done())
            return true;
        const Nanos now = loop.mQueue.Now();
        if (now >= deadline)
            return false;
        Wait(loop, deadline - now);
    }
}

WatchID AddDescriptorWatch(int descriptor, boost::function<void(int)> handler)
{
    return GetLoop().mWatches.Add(descriptor, std::move(handler));
}

void RemoveDescriptorWatch(WatchID watch)
{
    GetLoop().mWatches.Remove(watch);
}

WatchID AddTimerWatch(unsigned int periodMs, boost::function<void()> handler)
{
    const WatchID watch = GetLoop().mQueue.AddTimer(std::move(handler), std::max(periodMs, 1U) * kNanosPerMilli);
    ScheduleNextPump();
    return watch;
}

void RemoveTimerWatch(WatchID watch)
{
    GetLoop().mQueue.Remove(watch);
}

void SetMainThreadClock(const boost::function<unsigned long long()>& nanos)
{
    GetLoop().mQueue.SetClock(nanos);
    ScheduleNextPump();
}

} // namespace zebcore::threads
