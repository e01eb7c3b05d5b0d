#pragma once

#include "CoreFoundation/CFRunLoop.h"
#include "foundation/zebcore/MainThreadLoop.h"
#include "host/src/XAU/linux/src/CFObject.h"

#include <chrono>
#include <condition_variable>
#include <functional>
#include <map>
#include <memory>
#include <mutex>

/// Timers of one thread. The main thread's are watches of the main-thread loop; another thread's wait for
/// CFRunLoopRunInMode. Its thread keeps it, and so does each listener, which may go after the thread has ended.
struct CFOpaqueRunLoop final : zebaudiofilterhost::xau::cf::Object
{
    using TimerID = unsigned long long;
    using Clock = std::chrono::steady_clock;

    explicit CFOpaqueRunLoop(bool isMain);

    /// Calls the handler on the loop's thread once in each period, first after one. [the loop's thread]
    TimerID AddTimer(std::chrono::milliseconds period, std::function<void()> handler);
    /// The handler is not called again. [the loop's thread; of another thread's loop, from any other when it is done]
    void RemoveTimer(TimerID timer);

    SInt32 Run(Clock::duration time, bool returnAfterSourceHandled);

private:
    struct Timer
    {
        std::chrono::milliseconds period;
        Clock::time_point due;
        std::function<void()> handler;
    };

    // The handler that is due first, with its timer set on; empty if none is due by `now`.
    std::function<void()> TakeDue(Clock::time_point now);

    const bool mIsMain;
    std::mutex mMutex; // over what follows
    std::condition_variable mChanged;
    std::map<TimerID, Timer> mTimers;
    TimerID mLastTimer = 0;
};

/// A reference of its own to a loop.
using RunLoopPtr = std::unique_ptr<CFOpaqueRunLoop, zebaudiofilterhost::xau::cf::ReleaseObject>;
