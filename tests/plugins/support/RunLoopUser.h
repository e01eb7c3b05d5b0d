#pragma once

#include "tests/plugins/support/FixtureObject.h"

#include <array>
#include <string>

namespace fixture
{

// Registers a pipe and a timer with the run loop that the host context offers, and records when they wake it.
class RunLoopUser : public FixtureObject<Linux::IEventHandler, Linux::ITimerHandler>
{
public:
    RunLoopUser();
    ~RunLoopUser() override;

    bool Register(FUnknown* source); // false if the source offers no run loop
    void Unregister();

    // "write", "closeWriter", "registerAgain", "unregister"; false for another.
    bool CarryOut(const std::string& command);

    void PLUGIN_API onFDIsSet(Linux::FileDescriptor descriptor) override;
    void PLUGIN_API onTimer() override;

private:
    IPtr<Linux::IRunLoop> mRunLoop;
    std::array<int, 2> mPipe{-1, -1}; // read end, write end
    bool mAnnounced = false;
};

} // namespace fixture
