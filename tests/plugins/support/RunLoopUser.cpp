#include "tests/plugins/support/RunLoopUser.h"

#include "tests/plugins/support/HostAccess.h"

#include <fcntl.h>
#include <unistd.h>

namespace fixture
{

namespace
{

void Close(int& descriptor)
{
    if (descriptor >= 0)
        close(descriptor);
    descriptor = -1;
}

} // namespace

RunLoopUser::RunLoopUser()
{
    if (pipe2(mPipe.data(), O_NONBLOCK | O_CLOEXEC) != 0)
        mPipe = {-1, -1};
}

RunLoopUser::~RunLoopUser()
{
    Close(mPipe[0]);
    Close(mPipe[1]);
}

bool RunLoopUser::Register(FUnknown* source)
{
    mRunLoop = FUnknownPtr<Linux::IRunLoop>(source);
    Record("runLoop.found", mRunLoop != nullptr ? 1 : 0);
    if (mRunLoop == nullptr)
        return false;
    const tresult event = mRunLoop->registerEventHandler(this, mPipe[0]);
    const auto period = static_cast<Linux::TimerInterval>(Get(Knob::kTimerMilliseconds));
    const tresult timer = mRunLoop->registerTimer(this, period);
    Record("runLoop.registered", event, timer);
    return true;
}

void RunLoopUser::Unregister()
{
    if (mRunLoop == nullptr)
        return;
    const tresult timer = mRunLoop->unregisterTimer(this);
    const tresult event = mRunLoop->unregisterEventHandler(this);
    Record("runLoop.unregistered", event, timer);
    mRunLoop = nullptr;
}

bool RunLoopUser::CarryOut(const std::string& command)
{
    if (command == "write")
        return write(mPipe[1], "x", 1) == 1;
    if (command == "closeWriter")
        Close(mPipe[1]);
    else if (command == "registerAgain" && mRunLoop != nullptr)
        return mRunLoop->registerEventHandler(this, mPipe[0]) == kResultOk;
    else if (command == "unregister")
        Unregister();
    else
        return false;
    return true;
}

void PLUGIN_API RunLoopUser::onFDIsSet(Linux::FileDescriptor descriptor)
{
    std::array<char, 64> bytes{};
    const auto count = read(descriptor, bytes.data(), bytes.size());
    Record("runLoop.onFDIsSet", static_cast<int>(count));
    if (IsOn(Knob::kUnregisterInCallback))
        Unregister();
}

void PLUGIN_API RunLoopUser::onTimer()
{
    Record("runLoop.onTimer");
    if (IsOn(Knob::kLatencyFromTimer) && !mAnnounced && Handler() != nullptr)
    {
        mAnnounced = true;
        Set(Knob::kLatency, Get(Knob::kLatencyFromTimer));
        Handler()->restartComponent(kLatencyChanged | kParamTitlesChanged);
    }
    if (IsOn(Knob::kUnregisterInCallback))
        Unregister();
}

} // namespace fixture
