#pragma once

#include "foundation/zebcore/MainThreadLoop.h"

#include <boost/function.hpp>

#include <map>
#include <memory>
#include <mutex>
#include <optional>

namespace zebcore::threads
{

/// Delayed calls and repeating timers in the order in which they fall due. Internal to the main-thread loop. All
/// operations may be called from any thread, RunDue from the main thread only.
class MainThreadQueue
{
public:
    using Nanos = unsigned long long;
    using Clock = boost::function<Nanos()>;
    using Function = boost::function<void()>;

    WatchID AddCall(Function function, Nanos delay);
    WatchID AddTimer(Function function, Nanos period);
    void Remove(WatchID watch);

    /// Runs what is due and was queued before this call. True when something ran.
    bool RunDue();
    /// None when nothing is queued, 0 when something is due.
    std::optional<Nanos> NanosUntilNext() const;

    /// An empty function is the real clock. What is queued keeps the time it still has to wait.
    void SetClock(const Clock& clock);
    bool HasOwnClock() const;
    Nanos Now() const;

private:
    struct Call
    {
        Function mFunction;
        Nanos mPeriod; ///< 0 for a delayed call.
        bool mRunning = false;
    };
    /// The watch's own ID keeps calls with the same due time in the order of queueing.
    struct Key
    {
        Nanos mDue;
        WatchID mSequence;

        bool operator<(const Key& other) const
        {
            return mDue != other.mDue ? mDue < other.mDue : mSequence < other.mSequence;
        }
    };
    struct Entry
    {
        WatchID mWatch;
        std::shared_ptr<Call> mCall;
    };

    WatchID Add(Function function, Nanos delay, Nanos period);
    std::optional<Entry> TakeDue(Nanos now, WatchID firstOfNextRun);

    mutable std::mutex mMutex;
    std::map<Key, Entry> mEntries;
    std::shared_ptr<const Clock> mClock;
};

/// The next ID of the process. [any]
WatchID NextWatchID();

/// Tells the platform when the next queued call falls due. [any]
void ScheduleNextPump();

/// A pump for a platform whose own loop runs the main thread, called by that loop, which polls. [main]
void PumpInsideSystemLoop();

} // namespace zebcore::threads
