#pragma once

#include "foundation/zebcore/MainThreadLoop.h"
#include "host/src/VST3/src/HostObject.h"
#include "host/src/VST3/src/PluginPtr.h"

#include <pluginterfaces/gui/iplugview.h>

#include <memory>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// The event loop that plug-ins get on Linux, served by the main-thread loop: descriptors wake their handlers when
/// they are readable, in error or hung up, timers repeat. Any number of handlers may share a descriptor, and one
/// handler may be there several times; a handler is kept alive while it is registered. A plug-in's other threads are
/// refused with kResultFalse: registrations and the loop have no lock. Counted from 1, on any thread. [main]
class RunLoop final : public Steinberg::Linux::IRunLoop
{
public:
    RunLoop() = default;
    RunLoop(const RunLoop&) = delete;
    RunLoop& operator=(const RunLoop&) = delete;

    /// The number of the next registration.
    unsigned int Mark() const { return mNextNumber; }
    /// Forgets all registrations with this number or a later one.
    void ForgetSince(unsigned int mark);
    /// Forgets everything and takes no new registrations: plug-ins may keep the object for longer than its owner
    /// lives.
    void Close();

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** obj) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    Steinberg::tresult PLUGIN_API registerEventHandler(Steinberg::Linux::IEventHandler* handler,
                                                       Steinberg::Linux::FileDescriptor fd) override;
    /// Takes the handler away from all its descriptors; kResultFalse if it has none.
    Steinberg::tresult PLUGIN_API unregisterEventHandler(Steinberg::Linux::IEventHandler* handler) override;
    Steinberg::tresult PLUGIN_API registerTimer(Steinberg::Linux::ITimerHandler* handler,
                                                Steinberg::Linux::TimerInterval milliseconds) override;
    /// Stops all timers of the handler; kResultFalse if it has none.
    Steinberg::tresult PLUGIN_API unregisterTimer(Steinberg::Linux::ITimerHandler* handler) override;

private:
    struct Registration;
    using RegistrationPtr = std::shared_ptr<Registration>;

    ~RunLoop();

    Steinberg::tresult Add(const RegistrationPtr& registration, zebcore::threads::WatchID watch);
    template <class Forgotten>
    bool Forget(Forgotten forgotten);

    HostReferenceCount mReferenceCount;
    std::vector<RegistrationPtr> mRegistrations;
    unsigned int mNextNumber = 0;
    bool mClosed = false;
};

} // namespace zebaudiofilterhost::vst3
