#include "foundation/zebcore/internal/DescriptorPoller.h"

#include "foundation/zebcore/Trace.h"
#include "foundation/zebcore/internal/MainThreadQueue.h"

#include <CoreFoundation/CoreFoundation.h>

#include <cstddef>
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

void DoNothing(void* /*info*/)
{
}

} // namespace

/// On the main run loop. Where the application runs it, it calls back here, and this pumps. Where a wait of ours runs
/// it, there are only reports, also from what the application runs inside that: whoever waits pumps afterwards, and
/// gets to know what ran and what it threw.
class DescriptorPoller::Impl
{
public:
    explicit Impl(boost::function<void(int)> report) : mReport(std::move(report))
    {
        constexpr CFTimeInterval kRepeats =
            1e9; // Only a repeating timer can be set again; it is set before it repeats.
        CFRunLoopTimerContext timer{};
        timer.info = this;
        mTimer = CFRunLoopTimerCreate(kCFAllocatorDefault, After(std::chrono::hours(1)), kRepeats, 0, 0,
                                      &Impl::OnTimer, &timer);
        CFRunLoopAddTimer(CFRunLoopGetMain(), mTimer, kCFRunLoopCommonModes);
        CFRunLoopSourceContext wake{};
        wake.perform = DoNothing;
        mWake = CFRunLoopSourceCreate(kCFAllocatorDefault, 0, &wake);
        CFRunLoopAddSource(CFRunLoopGetMain(), mWake, kCFRunLoopCommonModes);
    }
    Impl(const Impl&) = delete;
    Impl& operator=(const Impl&) = delete;
    ~Impl()
    {
        CFRunLoopSourceInvalidate(mWake);
        CFRelease(mWake);
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

    void Poll()
    {
        // A run ends with the first source that was ready, be it a descriptor's, the wake-up or the application's.
        for (std::size_t runs = mSources.size() + 1; runs > 0; --runs)
        {
            if (Run(std::chrono::nanoseconds::zero()) != kCFRunLoopRunHandledSource)
                return;
        }
    }

    CFRunLoopRunResult Run(std::chrono::nanoseconds longest)
    {
        const RunEnd end(*this);
        return CFRunLoopRunInMode(kCFRunLoopDefaultMode, std::chrono::duration<double>(longest).count(), true);
    }

    void Wake(std::chrono::nanoseconds delay)
    {
        CFRunLoopTimerSetNextFireDate(mTimer, After(delay));
        // The timer alone ends no run, and to stop the run loop might end one of the application's inside ours.
        CFRunLoopSourceSignal(mWake);
        CFRunLoopWakeUp(CFRunLoopGetMain());
    }

private:
    /// Ends a run of ours, also when something in it throws.
    class RunEnd
    {
    public:
        explicit RunEnd(Impl& poller) : mPoller(poller), mIsInner(std::exchange(poller.mRunning, true)) {}
        RunEnd(const RunEnd&) = delete;
        RunEnd& operator=(const RunEnd&) = delete;
        ~RunEnd()
        {
            mPoller.mRunning = mIsInner;
            // Nobody may pump after this run: the application's next one does then.
            if (std::exchange(mPoller.mTimerFired, false))
                CFRunLoopTimerSetNextFireDate(mPoller.mTimer, CFAbsoluteTimeGetCurrent());
        }

    private:
        Impl& mPoller;
        bool mIsInner;
    };

    static void OnTimer(CFRunLoopTimerRef /*timer*/, void* info)
    {
        auto& self = *static_cast<Impl*>(info);
        if (self.mRunning)
            self.mTimerFired = true;
        else
            self.Pump();
    }

    static void OnReady(CFFileDescriptorRef source, CFOptionFlags /*callBacks*/, void* info)
    {
        auto& self = *static_cast<Impl*>(info);
        self.mReport(CFFileDescriptorGetNativeDescriptor(source));
        if (!self.mRunning)
            self.Pump();
    }

    /// For the application's run loop, which calls back through code that knows no exceptions.
    void Pump()
    {
        try
        {
            PumpInsideSystemLoop();
            ScheduleNextPump();
            return;
        }
        catch (const std::exception& exception)
        {
            ZEB_TRACE("MainThreadLoop", "A handler threw: " << exception.what());
        }
        catch (...)
        {
            ZEB_TRACE("MainThreadLoop", "A handler threw");
        }
        Wake(std::chrono::nanoseconds::zero()); // for what was still to do
    }

    boost::function<void(int)> mReport;
    CFRunLoopTimerRef mTimer = nullptr;
    CFRunLoopSourceRef mWake = nullptr; ///< Ends a run of ours.
    bool mRunning = false;              ///< A run of ours is under way.
    bool mTimerFired = false;           ///< In a run of ours.
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
    mImpl->Poll();
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
