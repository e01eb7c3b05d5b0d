#include "host/src/VST3/src/HostRunLoop.h"

namespace zebaudiofilterhost::vst3
{

// Plug-ins use the run loop of the process.
class HostRunLoop::Impl
{
};

HostRunLoop::HostRunLoop() = default;
HostRunLoop::~HostRunLoop() = default;

Steinberg::tresult HostRunLoop::QueryInterface(const Steinberg::TUID /*iid*/, void** /*obj*/) const
{
    return Steinberg::kNoInterface;
}

unsigned int HostRunLoop::Mark() const
{
    return 0;
}

void HostRunLoop::ForgetSince(unsigned int /*mark*/)
{
}

} // namespace zebaudiofilterhost::vst3
