#pragma once

#include "host/src/XAU/linux/src/CFRunLoopObject.h"
#include "host/src/XAU/linux/src/ListenerTable.h"

#include <boost/lockfree/policies.hpp>
#include <boost/lockfree/queue.hpp>

#include <atomic>
#include <chrono>
#include <memory>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// Something that was told and is to be heard.
struct Told
{
    Interest mInterest;
    UInt64 mHostTime; // nanoseconds
    AudioUnitParameterValue mValue;
};

} // namespace zebaudiofilterhost::xau

/// Collects what it is told on any thread, and passes it on by a timer of its loop.
struct AUListenerBase
{
    using Seconds = std::chrono::duration<double>;

    AUListenerBase(AUEventListenerProc proc, void* userData, CFRunLoopRef loop, Seconds interval,
                   Seconds granularity);
    ~AUListenerBase();
    AUListenerBase(const AUListenerBase&) = delete;
    AUListenerBase& operator=(const AUListenerBase&) = delete;

    /// Neither allocates nor locks. [any]
    void Tell(const zebaudiofilterhost::xau::Told& told);

    // The loop's thread.
    std::vector<zebaudiofilterhost::xau::Interest> mInterests;

private:
    static constexpr std::size_t kCapacity = 1024; // changes between two passes of the timer

    void Deliver();
    std::vector<zebaudiofilterhost::xau::Told> Collect();
    void AddLost(std::vector<zebaudiofilterhost::xau::Told>& batch) const;
    bool IsSuperseded(const std::vector<zebaudiofilterhost::xau::Told>& batch, std::size_t index) const;

    AUEventListenerProc mProc;
    void* mUserData;
    CFRunLoopRef mLoop;
    std::chrono::nanoseconds mGranularity;
    CFOpaqueRunLoop::TimerID mTimer;
    boost::lockfree::queue<zebaudiofilterhost::xau::Told, boost::lockfree::capacity<kCapacity>> mTold;
    std::atomic<bool> mHasLost = false;                            // the queue was full
    std::shared_ptr<bool> mIsAlive = std::make_shared<bool>(true); // a callback may dispose of the listener
};
