#include "utility/ThreadUtils.h"

#include <atomic>

namespace zebaudiofilterhost
{

namespace
{

// Relaxed: written before the application makes any other thread that asks.
constinit std::atomic<zebcore::threads::ThreadID> sMainThreadID{0};

} // namespace

void InitializeMainThreadID()
{
    sMainThreadID.store(zebcore::threads::GetCurrentThreadID(), std::memory_order_relaxed);
}

zebcore::threads::ThreadID GetMainThreadID()
{
    return sMainThreadID.load(std::memory_order_relaxed);
}

bool CurrentThreadIDIsMainThreadID()
{
    return zebcore::threads::GetCurrentThreadID() == GetMainThreadID();
}

} // namespace zebaudiofilterhost
