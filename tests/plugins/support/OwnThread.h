#pragma once

#include <atomic>
#include <thread>

namespace fixture
{

// A thread of the plug-in's own that calls the host without pause while audio runs, as its knobs say.
class OwnThread
{
public:
    OwnThread() = default;
    ~OwnThread() { Stop(); }
    OwnThread(const OwnThread&) = delete;
    OwnThread& operator=(const OwnThread&) = delete;

    void Start();
    void Stop();

private:
    void Run();

    std::atomic<bool> mStop{false};
    std::thread mThread;
};

} // namespace fixture
