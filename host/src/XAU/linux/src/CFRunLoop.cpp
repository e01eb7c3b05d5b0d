#include "CoreFoundation/CFRunLoop.h"

#include "CoreFoundation/CFString.h"
#include "host/src/XAU/linux/src/CFRunLoopObject.h"
#include "utility/ThreadUtils.h"

#include <algorithm>
#include <memory>
#include <utility>

using namespace zebaudiofilterhost;
using namespace zebaudiofilterhost::xau;

const CFStringRef kCFRunLoopDefaultMode = CFSTR("kCFRunLoopDefaultMode");

CFOpaqueRunLoop::CFOpaqueRunLoop(bool isMain) : Object(cf::TypeID::RunLoop), mIsMain(isMain)
{
}

CFOpaqueRunLoop::TimerID CFOpaqueRunLoop::AddTimer(std::chrono::milliseconds period, std::function<void()> handler)
{
    if (mIsMain)
        return zebcore::threads::AddTimerWatch(static_cast<unsigned int>(period.count()), std::move(handler));
    const std::lock_guard lock(mMutex);
    mTimers.emplace(++mLastTimer, Timer{period, Clock::now() + period, std::move(handler)});
    mChanged.notify_all();
    return mLastTimer;
}

void CFOpaqueRunLoop::RemoveTimer(TimerID timer)
{
    if (mIsMain)
    {
        zebcore::threads::RemoveTimerWatch(timer);
        return;
    }
    const std::lock_guard lock(mMutex);
    mTimers.erase(timer);
}

std::function<void()> CFOpaqueRunLoop::TakeDue(Clock::time_point now)
{
    const auto next = std::min_element(mTimers.begin(), mTimers.end(),
                                       [](const auto& a, const auto& b) { return a.second.due < b.second.due; });
    if (next == mTimers.end() || next->second.due > now)
        return {};
    next->second.due = now + next->second.period;
    return next->second.handler;
}

SInt32 CFOpaqueRunLoop::Run(Clock::duration time, bool returnAfterSourceHandled)
{
    if (mIsMain)
    {
        const auto limit = std::chrono::ceil<std::chrono::milliseconds>(time).count();
        zebcore::threads::RunMainThreadUntil({}, static_cast<unsigned int>(limit));
        return kCFRunLoopRunTimedOut;
    }
    const Clock::time_point end = Clock::now() + time;
    std::unique_lock lock(mMutex);
    while (!mTimers.empty())
    {
        if (const std::function<void()> handler = TakeDue(Clock::now()))
        {
            lock.unlock();
            handler();
            lock.lock();
            if (returnAfterSourceHandled)
                return kCFRunLoopRunHandledSource;
            if (Clock::now() < end)
                continue;
        }
        if (Clock::now() >= end)
            return kCFRunLoopRunTimedOut;
        const auto next = std::min_element(mTimers.begin(), mTimers.end(),
                                           [](const auto& a, const auto& b) { return a.second.due < b.second.due; });
        mChanged.wait_until(lock, std::min(end, next->second.due));
    }
    return kCFRunLoopRunFinished;
}

CFRunLoopRef CFRunLoopGetCurrent()
{
    static const RunLoopPtr sMain(new CFOpaqueRunLoop(true));
    if (CurrentThreadIDIsMainThreadID())
        return sMain.get();
    thread_local const RunLoopPtr sOwn(new CFOpaqueRunLoop(false));
    return sOwn.get();
}

SInt32 CFRunLoopRunInMode(CFStringRef /*mode*/, CFTimeInterval seconds, Boolean returnAfterSourceHandled)
{
    constexpr CFTimeInterval kLongest = 1e6; // Beyond this a clock's numbers would overflow.
    const std::chrono::duration<double> time(seconds > 0.0 ? std::min(seconds, kLongest) : 0.0); // also for no number
    return CFRunLoopGetCurrent()->Run(std::chrono::duration_cast<CFOpaqueRunLoop::Clock::duration>(time),
                                      returnAfterSourceHandled != 0);
}
