#include "foundation/zebcore/internal/DescriptorPoller.h"

#include "foundation/zebcore/MainThreadLoop.h"
#include "foundation/zebcore/Trace.h"
#include "foundation/zebcore/internal/MainThreadQueue.h"

#include <CoreFoundation/CoreFoundation.h>

#include <exception>
#include <map>
#include <utility>

namespace zebcore::threads
{

namespace
{

CFAbsoluteTime After(std::chrono::nanoseconds delay)
{
    return CFAbsoluteTimeGetCurrent() + std::chrono::duration<double>(delay).count();
}

/// The run loop calls back through code that knows no exceptions.
void PumpFromRunLoop()
{
    try
    {
        PumpMainThread();
    }
    catch (const std::exception& exception)
    {
        ZEB_TRACE("MainThreadLoop", "A handler threw: " << exception.what());
    }
    catch (...)
    {
        ZEB_TRACE("MainThreadLoop", "A handler threw");
    }
    ScheduleNextPump();
}

void OnTimer(CFRunLoopTimerRef /*timer*/, void* /*info*/)
{
    PumpFromRunLoop();
}

} // namespace

class DescriptorPoller::Impl
{
public:
    explicit Impl(boost::function<void(int)> report) : mReport(std::move(report))
    {
        constexpr CFTimeInterval kRepeats =
            1e9; // Only a repeating timer can be set again; it is set before it repeats.
        mTimer =
            CFRunLoopTimerCreate(kCFAllocatorDefault, After(std::chrono::hours(1)), kRepeats, 0, 0, OnTimer, nullptr);
        CFRunLoopAddTimer(CFRunLoopGetMain(), mTimer, kCFRunLoopCommonModes);
    }
    Impl(const Impl&) = delete;
    Impl& operator=(const Impl&) = delete;
    ~Impl()
    {
        CFRunLoopTimerInvalidate(mTimer);
        CFRelease(mTimer);
    }

    bool Register(int descriptor)
    {
        Forget(descriptor);
        const CFFileDescriptorContext context{0, this, nullptr, nullptr, nullptr};
        const CFFileDescriptorRef source =
            CFFileDescriptorCreate(kCFAllocatorDefault, descriptor, false, &Impl::OnReady, &context);
        if (source == nullptr)
            return false;
        const CFRunLoopSourceRef loopSource = CFFileDescriptorCreateRunLoopSource(kCFAllocatorDefault, source, 0);
        CFRunLoopAddSource(CFRunLoopGetMain(), loopSource, kCFRunLoopCommonModes);
        CFRelease(loopSource);
        mSources.emplace(descriptor, source);
        return true;
    }

    void Await(int descriptor)
    {
        const auto known = mSources.find(descriptor);
        if (known != mSources.end())
            CFFileDescriptorEnableCallBacks(known->second, kCFFileDescriptorReadCallBack);
    }

    void Forget(int descriptor)
    {
        const auto known = mSources.find(descriptor);
        if (known == mSources.end())
            return;
        CFFileDescriptorInvalidate(known->second);
        CFRelease(known->second);
        mSources.erase(known);
    }

    void Run(std::chrono::nanoseconds longest)
    {
        CFRunLoopRunInMode(kCFRunLoopDefaultMode, std::chrono::duration<double>(longest).count(), true);
    }

    void Wake(std::chrono::nanoseconds delay)
    {
        CFRunLoopTimerSetNextFireDate(mTimer, After(delay));
        CFRunLoopWakeUp(CFRunLoopGetMain());
    }

private:
    static void OnReady(CFFileDescriptorRef source, CFOptionFlags /*callBacks*/, void* info)
    {
        static_cast<Impl*>(info)->mReport(CFFileDescriptorGetNativeDescriptor(source));
        PumpFromRunLoop();
    }

    boost::function<void(int)> mReport;
    CFRunLoopTimerRef mTimer = nullptr;
    std::map<int, CFFileDescriptorRef> mSources;
};

DescriptorPoller::DescriptorPoller(boost::function<void(int)> report)
    : mImpl(std::make_unique<Impl>(std::move(report)))
{
}

DescriptorPoller::~DescriptorPoller() = default;

bool DescriptorPoller::Register(int descriptor)
{
    return mImpl->Register(descriptor);
}

void DescriptorPoller::Await(int descriptor)
{
    mImpl->Await(descriptor);
}

void DescriptorPoller::Forget(int descriptor)
{
    mImpl->Forget(descriptor);
}

void DescriptorPoller::Poll()
{
    mImpl->Run(std::chrono::nanoseconds::zero());
}

void DescriptorPoller::Wait(std::chrono::nanoseconds longest)
{
    mImpl->Run(longest);
}

void DescriptorPoller::Wake(std::chrono::nanoseconds delay)
{
    mImpl->Wake(delay);
}

} // namespace zebcore::threads
