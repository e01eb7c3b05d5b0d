#pragma once

#include "utility/ThreadUtils.h"

#include <atomic>
#include <cstdint>
#include <thread>

namespace zebaudiofilterhost::vst3
{

/// Lets calls in that a plug-in makes from threads of its own, from Open to Close, and does not close while one is
/// under way. Those of the main thread, which opens and closes it, come in from the start to Close, and are not
/// waited for: one of them may be what closes it.
class CallGate
{
public:
    /// Whether a call may come in; it leaves when this object goes. [any]
    class Call
    {
    public:
        explicit Call(CallGate& gate) : mGate(gate), mIsMain(CurrentThreadIDIsMainThreadID())
        {
            // Acquires what was made ahead of Open.
            const std::uint32_t state = mIsMain ? gate.mState.load(std::memory_order_relaxed)
                                                : gate.mState.fetch_add(1, std::memory_order_acquire);
            mIsIn = mIsMain ? (state & kClosed) == 0 : (state & (kClosed | kOpen)) == kOpen;
        }
        ~Call()
        {
            if (!mIsMain)
                mGate.mState.fetch_sub(1,
                                       std::memory_order_release); // gives the plug-in's objects back to who closes
        }
        Call(const Call&) = delete;
        Call& operator=(const Call&) = delete;

        explicit operator bool() const { return mIsIn; }

    private:
        CallGate& mGate;
        bool mIsMain;
        bool mIsIn;
    };

    /// [main]
    void Open() { mState.fetch_or(kOpen, std::memory_order_release); }

    /// For good. [main]
    void Close()
    {
        mState.fetch_or(kClosed, std::memory_order_relaxed);
        while ((mState.load(std::memory_order_acquire) & kCount) != 0)
            std::this_thread::yield();
    }

private:
    static constexpr std::uint32_t kClosed = 1U << 31U;
    static constexpr std::uint32_t kOpen = 1U << 30U;
    static constexpr std::uint32_t kCount = kOpen - 1;

    std::atomic<std::uint32_t> mState = 0;
};

} // namespace zebaudiofilterhost::vst3
