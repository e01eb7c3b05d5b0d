#include "host/src/VST3/src/HostRunLoop.h"

#include "host/src/VST3/src/linux/RunLoop.h"

namespace zebaudiofilterhost::vst3
{

class HostRunLoop::Impl
{
public:
    Impl() : mRunLoop(PluginPtr<RunLoop>::Adopt(new RunLoop)) {}
    ~Impl() { mRunLoop->Close(); }
    Impl(const Impl&) = delete;
    Impl& operator=(const Impl&) = delete;

    RunLoop& Get() const { return *mRunLoop; }

private:
    PluginPtr<RunLoop> mRunLoop;
};

HostRunLoop::HostRunLoop() : mImpl(std::make_unique<Impl>())
{
}

HostRunLoop::~HostRunLoop() = default;

Steinberg::tresult HostRunLoop::QueryInterface(const Steinberg::TUID iid, void** obj) const
{
    using Steinberg::Linux::IRunLoop;
    if (!Steinberg::FUnknownPrivate::iidEqual(iid, IRunLoop::iid))
        return Steinberg::kNoInterface;
    IRunLoop& runLoop = mImpl->Get();
    runLoop.addRef();
    *obj = &runLoop;
    return Steinberg::kResultOk;
}

unsigned int HostRunLoop::Mark() const
{
    return mImpl->Get().Mark();
}

void HostRunLoop::ForgetSince(unsigned int mark)
{
    mImpl->Get().ForgetSince(mark);
}

} // namespace zebaudiofilterhost::vst3
