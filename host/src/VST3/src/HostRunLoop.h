#pragma once

#include <pluginterfaces/base/funknown.h>

#include <memory>

namespace zebaudiofilterhost::vst3
{

/// The event loop that a plug-in may ask of its host where the platform has none of its own: on Linux
/// Steinberg::Linux::IRunLoop, served by the main-thread loop; elsewhere nothing.
///
/// What a plug-in leaves registered is forgotten with the owner. Main thread only.
class HostRunLoop
{
public:
    HostRunLoop();
    ~HostRunLoop();
    HostRunLoop(const HostRunLoop&) = delete;
    HostRunLoop& operator=(const HostRunLoop&) = delete;

    /// Answers the platform's run-loop interface with an added reference; anything else gives kNoInterface and leaves
    /// `obj` alone. [any]
    Steinberg::tresult QueryInterface(const Steinberg::TUID iid, void** obj) const;

    /// A mark for ForgetSince: everything registered from now on lies behind it. [main]
    unsigned int Mark() const;

    /// Forgets what was registered behind `mark` and is still there. [main]
    void ForgetSince(unsigned int mark);

    /// Forgets everything that is registered. [main]
    void ForgetAll() { ForgetSince(0); }

private:
    class Impl;
    std::unique_ptr<Impl> mImpl;
};

} // namespace zebaudiofilterhost::vst3
