#include "host/src/VST3/src/linux/RunLoop.h"

#include "utility/ThreadUtils.h"

#include <algorithm>
#include <iterator>
#include <limits>

namespace zebaudiofilterhost::vst3
{

using Steinberg::kInvalidArgument;
using Steinberg::kResultFalse;
using Steinberg::kResultOk;
using Steinberg::tresult;
using Steinberg::Linux::IEventHandler;
using Steinberg::Linux::ITimerHandler;

// One of the two handlers is set.
struct RunLoop::Registration
{
    unsigned int mNumber = 0;
    PluginPtr<IEventHandler> mEventHandler;
    PluginPtr<ITimerHandler> mTimerHandler;
    zebcore::threads::WatchID mWatch = zebcore::threads::kNoWatch;
};

namespace
{

// A handler that is un-registered, in its own call too, is not called again and lives to the end of the call. What it
// throws goes no further.
template <class Registration, class Call>
void CallHandler(const std::weak_ptr<Registration>& weak, Call call)
{
    const std::shared_ptr<Registration> registration = weak.lock();
    if (!registration)
        return;
    try
    {
        call(*registration);
    }
    catch (...)
    {
    }
}

} // namespace

RunLoop::~RunLoop()
{
    Close();
}

// Registrations are taken out before their handlers go: a handler's destructor may call back.
template <class Forgotten>
bool RunLoop::Forget(Forgotten forgotten)
{
    std::vector<RegistrationPtr> gone;
    const auto first = std::stable_partition(mRegistrations.begin(), mRegistrations.end(),
                                             [&](const RegistrationPtr& entry) { return !forgotten(*entry); });
    std::move(first, mRegistrations.end(), std::back_inserter(gone));
    mRegistrations.erase(first, mRegistrations.end());
    for (const RegistrationPtr& entry : gone)
    {
        if (entry->mEventHandler)
            zebcore::threads::RemoveDescriptorWatch(entry->mWatch);
        else
            zebcore::threads::RemoveTimerWatch(entry->mWatch);
    }
    return !gone.empty();
}

void RunLoop::ForgetSince(unsigned int mark)
{
    Forget([mark](const Registration& entry) { return entry.mNumber >= mark; });
}

void RunLoop::Close()
{
    mClosed = true;
    ForgetSince(0);
}

tresult RunLoop::Add(const RegistrationPtr& registration, zebcore::threads::WatchID watch)
{
    if (watch == zebcore::threads::kNoWatch)
        return kResultFalse;
    registration->mWatch = watch;
    mRegistrations.push_back(registration);
    ++mNextNumber;
    return kResultOk;
}

tresult PLUGIN_API RunLoop::queryInterface(const Steinberg::TUID interfaceID, void** obj)
{
    return QueryHostObject<Steinberg::Linux::IRunLoop>(*this, interfaceID, obj);
}

Steinberg::uint32 PLUGIN_API RunLoop::addRef()
{
    return mReferenceCount.Add();
}

Steinberg::uint32 PLUGIN_API RunLoop::release()
{
    const Steinberg::uint32 count = mReferenceCount.Remove();
    if (count == 0)
        delete this;
    return count;
}

tresult PLUGIN_API RunLoop::registerEventHandler(IEventHandler* handler, Steinberg::Linux::FileDescriptor fd)
{
    if (!handler || fd < 0)
        return kInvalidArgument;
    if (!CurrentThreadIDIsMainThreadID() || mClosed)
        return kResultFalse;
    const auto registration = std::make_shared<Registration>();
    registration->mNumber = mNextNumber;
    registration->mEventHandler = PluginPtr<IEventHandler>::Retain(handler);
    const std::weak_ptr<Registration> weak = registration;
    const auto wake = [](int ready)
    {
        return [ready](Registration& entry)
        {
            entry.mEventHandler->onFDIsSet(ready);
        };
    };
    return Add(registration,
               zebcore::threads::AddDescriptorWatch(fd, [weak, wake](int ready) { CallHandler(weak, wake(ready)); }));
}

tresult PLUGIN_API RunLoop::unregisterEventHandler(IEventHandler* handler)
{
    if (!handler)
        return kInvalidArgument;
    if (!CurrentThreadIDIsMainThreadID())
        return kResultFalse;
    const bool found = Forget([handler](const Registration& entry) { return entry.mEventHandler.Get() == handler; });
    return found ? kResultOk : kResultFalse;
}

tresult PLUGIN_API RunLoop::registerTimer(ITimerHandler* handler, Steinberg::Linux::TimerInterval milliseconds)
{
    if (!handler)
        return kInvalidArgument;
    if (!CurrentThreadIDIsMainThreadID() || mClosed)
        return kResultFalse;
    const auto registration = std::make_shared<Registration>();
    registration->mNumber = mNextNumber;
    registration->mTimerHandler = PluginPtr<ITimerHandler>::Retain(handler);
    const std::weak_ptr<Registration> weak = registration;
    constexpr Steinberg::Linux::TimerInterval kLongest = std::numeric_limits<int>::max();
    const auto period = static_cast<unsigned int>(std::min(milliseconds, kLongest));
    const auto wake = [](Registration& entry)
    {
        entry.mTimerHandler->onTimer();
    };
    return Add(registration, zebcore::threads::AddTimerWatch(period, [weak, wake] { CallHandler(weak, wake); }));
}

tresult PLUGIN_API RunLoop::unregisterTimer(ITimerHandler* handler)
{
    if (!handler)
        return kInvalidArgument;
    if (!CurrentThreadIDIsMainThreadID())
        return kResultFalse;
    const bool found = Forget([handler](const Registration& entry) { return entry.mTimerHandler.Get() == handler; });
    return found ? kResultOk : kResultFalse;
}

} // namespace zebaudiofilterhost::vst3
