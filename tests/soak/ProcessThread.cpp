#include "ProcessThread.h"

#include "foundation/zebcore/MainThreadLoop.h"

#include <chrono>

#include <immintrin.h>

namespace soak
{

ProcessThread::ProcessThread() : mThread([this] { Serve(); })
{
}

ProcessThread::~ProcessThread()
{
    {
        const std::lock_guard lock(mMutex);
        mEnds = true;
    }
    mChanged.notify_all();
    mThread.join();
}

void ProcessThread::Run(const std::function<void()>& work)
{
    {
        const std::lock_guard lock(mMutex);
        mWork = work;
    }
    mChanged.notify_all();
    while (!IsDoneWithin(1))
    {
        zebcore::threads::PumpMainThread();
    }
}

bool ProcessThread::IsDoneWithin(unsigned int milliseconds)
{
    std::unique_lock lock(mMutex);
    return mChanged.wait_for(lock, std::chrono::milliseconds(milliseconds), [this] { return !mWork; });
}

void ProcessThread::Serve()
{
    constexpr unsigned int kFlushToZeroAndDenormalsAreZero = 0x8040;
    _mm_setcsr(_mm_getcsr() | kFlushToZeroAndDenormalsAreZero);
    std::unique_lock lock(mMutex);
    for (;;)
    {
        mChanged.wait(lock, [this] { return mEnds || mWork; });
        if (mEnds)
        {
            return;
        }
        lock.unlock();
        mWork();
        lock.lock();
        mWork = nullptr;
        mChanged.notify_all();
    }
}

} // namespace soak
