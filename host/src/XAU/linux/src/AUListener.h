#pragma once

#include "host/src/XAU/linux/src/CFRunLoopObject.h"
#include "host/src/XAU/linux/src/ListenerTable.h"

#include <boost/lockfree/policies.hpp>
#include <boost/lockfree/queue.hpp>

#include <atomic>
#include <chrono>
#include <deque>
#include <memory>
#include <unordered_set>
#include <vector>

/// Collects what it is told on any thread, and passes it on by a timer of its loop. Nothing that it is told is lost:
/// when more waits than its queues hold, a row counts its gestures, and remembers that its value is to be read.
struct AUListenerBase
{
    using Seconds = std::chrono::duration<double>;
    using Row = zebaudiofilterhost::xau::ListenerRow;
    using TablePtr = std::shared_ptr<zebaudiofilterhost::xau::ListenerTable>;

    AUListenerBase(AUEventListenerProc proc, void* userData, CFRunLoopRef loop, Seconds interval,
                   Seconds granularity);
    ~AUListenerBase();
    AUListenerBase(const AUListenerBase&) = delete;
    AUListenerBase& operator=(const AUListenerBase&) = delete;

    /// Nothing the second time, and nothing if it is not there. [the loop's thread]
    void Add(const AudioUnitEvent& event, void* object, const TablePtr& table);
    void Remove(const AudioUnitEvent& event, void* object, const TablePtr& table);

    /// Something has happened; only a changed value counts. Neither allocates nor locks. [any]
    void Tell(Row& row, UInt64 hostTime, AudioUnitParameterValue value);
    /// The value may have changed: it is read when it is passed on. Neither allocates nor locks. [any]
    void TellToRead(Row& row);
    /// A unit that it listens to goes. [any]
    void LoseUnit() { mHasLostUnit.store(true, std::memory_order_release); }

private:
    using RowPtr = std::shared_ptr<Row>;

    struct Told
    {
        Row* mRow;
        UInt64 mNumber;   // in the order of telling
        UInt64 mHostTime; // nanoseconds
        AudioUnitParameterValue mValue;
    };

    // What was told, with the row until it is passed on.
    struct Heard
    {
        RowPtr mRow;
        UInt64 mNumber;
        UInt64 mHostTime;
        AudioUnitParameterValue mValue;
        UInt32 mTimes; // 0 for a value that a later one stands for
    };

    static constexpr std::size_t kCapacity = 1024; // between two passes of the timer
    using Queue = boost::lockfree::queue<Told, boost::lockfree::capacity<kCapacity>>;

    void MarkLeftOut();
    void Deliver();
    std::vector<Heard> Collect();
    void DropLostUnits();
    void AddLeftOut(std::vector<Heard>& batch) const;
    void DropSuperseded(std::vector<Heard>& batch);
    Row* Find(const AudioUnitEvent& event, const void* object, const TablePtr& table) const;

    AUEventListenerProc mProc;
    void* mUserData;
    RunLoopPtr mLoop; // its thread may have ended
    std::chrono::nanoseconds mGranularity;
    CFOpaqueRunLoop::TimerID mTimer;

    Queue mValues; // not in one queue with the rest, which they would fill
    Queue mOthers;
    std::atomic<UInt64> mNumber = 0;
    std::atomic<bool> mHasLeftOut = false;
    std::atomic<bool> mHasLostUnit = false;

    // The loop's thread.
    std::unordered_set<RowPtr> mRows;
    std::vector<RowPtr> mRemoved; // of which something may wait in a queue
    std::deque<Heard> mHeard;     // to be passed on, also by a later pass if a callback throws
    UInt64 mPart = 0;             // between two gestures
    std::shared_ptr<bool> mIsAlive = std::make_shared<bool>(true); // a callback may dispose of the listener
};
