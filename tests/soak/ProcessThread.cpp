#include "ProcessThread.h"

#include "CrashNote.h"
#include "MainLoop.h"

#include <chrono>
#include <utility>

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
    std::exception_ptr ofLoop;
    while (!IsDoneWithin(1))
    {
        try
        {
            ServeLoop();
        }
        catch (...) // the work still uses what lies on the caller's stack
        {
            ofLoop = std::current_exception();
        }
    }
    if (const std::exception_ptr ofWork = std::exchange(mThrown, nullptr))
    {
        std::rethrow_exception(ofWork);
    }
    if (ofLoop)
    {
        std::rethrow_exception(ofLoop);
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
    UseSignalStack();
    std::unique_lock lock(mMutex);
    for (;;)
    {
        mChanged.wait(lock, [this] { return mEnds || mWork; });
        if (mEnds)
        {
            return;
        }
        lock.unlock();
        DoWork();
        lock.lock();
        mWork = nullptr;
        mChanged.notify_all();
    }
}

// An effect may throw out of a block; the audio thread outlives that, as that of an application has to.
void ProcessThread::DoWork()
{
    try
    {
        mWork();
    }
    catch (...)
    {
        mThrown = std::current_exception();
    }
}

} // namespace soak
