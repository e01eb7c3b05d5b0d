#include "foundation/zebcore/internal/MainThreadQueue.h"

#include "foundation/zebcore/HighPrecisionTime.h"

#include <algorithm>
#include <atomic>
#include <iterator>
#include <utility>

namespace zebcore::threads
{

namespace
{

/// Keeps the phase, and leaves out the turns that have been missed.
MainThreadQueue::Nanos NextTurn(MainThreadQueue::Nanos due, MainThreadQueue::Nanos period, MainThreadQueue::Nanos now)
{
    return due + period * ((now - due) / period + 1);
}

/// Ends a run, also when it ends with an exception.
class RunEnd
{
public:
    explicit RunEnd(bool& running) : mRunning(running) {}
    RunEnd(const RunEnd&) = delete;
    RunEnd& operator=(const RunEnd&) = delete;
    ~RunEnd() { mRunning = false; }

private:
    bool& mRunning;
};

} // namespace

WatchID NextWatchID()
{
    static constinit std::atomic<WatchID> sLastWatch{kNoWatch};
    // Only uniqueness counts.
    return sLastWatch.fetch_add(1, std::memory_order_relaxed) + 1;
}

WatchID MainThreadQueue::AddCall(Function function, Nanos delay)
{
    return Add(std::move(function), delay, 0);
}

WatchID MainThreadQueue::AddTimer(Function function, Nanos period)
{
    return Add(std::move(function), period, period);
}

WatchID MainThreadQueue::Add(Function function, Nanos delay, Nanos period)
{
    auto call = std::make_shared<Call>(Call{std::move(function), period});
    const Nanos now = Now();
    const std::lock_guard lock(mMutex);
    const WatchID watch = NextWatchID();
    mEntries.emplace(Key{now + delay, watch}, Entry{watch, std::move(call)});
    return watch;
}

void MainThreadQueue::Remove(WatchID watch)
{
    std::map<Key, Entry>::node_type removed; // The handler is destroyed outside the lock.
    const std::lock_guard lock(mMutex);
    const auto entry = std::find_if(mEntries.begin(), mEntries.end(),
                                    [&](const auto& candidate) { return candidate.second.mWatch == watch; });
    if (entry != mEntries.end())
        removed = mEntries.extract(entry);
}

bool MainThreadQueue::RunDue()
{
    bool ran = false;
    const Nanos now = Now();
    const WatchID firstOfNextRun = NextWatchID();
    while (const std::optional<Entry> entry = TakeDue(now, firstOfNextRun))
    {
        Call& call = *entry->mCall;
        if (call.mRunning)
            continue;
        call.mRunning = true;
        const RunEnd end(call.mRunning);
        ran = true;
        call.mFunction();
    }
    return ran;
}

std::optional<MainThreadQueue::Entry> MainThreadQueue::TakeDue(Nanos now, WatchID firstOfNextRun)
{
    const std::lock_guard lock(mMutex);
    const auto first = mEntries.begin();
    if (first == mEntries.end() || first->first.mDue > now || first->first.mSequence > firstOfNextRun)
        return std::nullopt;

    // It leaves its place, or goes on to its next turn, before it runs: what it throws loses nothing.
    auto node = mEntries.extract(first);
    Entry entry = node.mapped();
    if (entry.mCall->mPeriod != 0)
    {
        node.key() = Key{NextTurn(node.key().mDue, entry.mCall->mPeriod, now), NextWatchID()};
        mEntries.insert(std::move(node));
    }
    return entry;
}

std::optional<MainThreadQueue::Nanos> MainThreadQueue::NanosUntilNext() const
{
    const Nanos now = Now();
    const std::lock_guard lock(mMutex);
    if (mEntries.empty())
        return std::nullopt;
    const Nanos due = mEntries.begin()->first.mDue;
    return due > now ? due - now : 0;
}

void MainThreadQueue::SetClock(const Clock& clock)
{
    const Nanos before = Now();
    {
        const std::lock_guard lock(mMutex);
        mClock = clock ? std::make_shared<const Clock>(clock) : nullptr;
    }
    const Nanos after = Now();

    const std::lock_guard lock(mMutex);
    std::map<Key, Entry> entries;
    for (auto& [key, entry] : mEntries)
    {
        const Nanos remaining = key.mDue > before ? key.mDue - before : 0;
        entries.emplace(Key{after + remaining, key.mSequence}, std::move(entry));
    }
    mEntries = std::move(entries);
}

bool MainThreadQueue::HasOwnClock() const
{
    const std::lock_guard lock(mMutex);
    return mClock != nullptr;
}

MainThreadQueue::Nanos MainThreadQueue::Now() const
{
    std::shared_ptr<const Clock> clock;
    {
        const std::lock_guard lock(mMutex);
        clock = mClock;
    }
    using utility::HighPrecisionTime;
    return clock ? (*clock)() : HighPrecisionTime::ConvertToNanos(HighPrecisionTime::GetCurrentTime());
}

} // namespace zebcore::threads
