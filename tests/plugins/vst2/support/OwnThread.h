#pragma once

#include "tests/plugins/vst2/support/HostCalls.h"

#include <atomic>
#include <thread>

namespace vst2fixture
{

// A thread of the plug-in's own that calls the host without pause.
class OwnThread
{
public:
    OwnThread() = default;
    ~OwnThread() { Stop(); }
    OwnThread(const OwnThread&) = delete;
    OwnThread& operator=(const OwnThread&) = delete;

    void Start(const HostAccess& access);
    void Stop();

private:
    std::atomic<bool> mStop{false};
    std::thread mThread;
};

} // namespace vst2fixture
