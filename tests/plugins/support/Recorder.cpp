#include "tests/plugins/support/Recorder.h"

#include <atomic>
#include <mutex>

namespace fixture
{

namespace
{

std::atomic<bool> sRecording{true};
std::atomic<int> sLiveObjects{0};
std::mutex sMutex;
std::string sCalls;
std::string sHandedOut;

} // namespace

bool IsRecording()
{
    return sRecording.load(std::memory_order_relaxed);
}

void SetRecording(bool on)
{
    sRecording.store(on, std::memory_order_relaxed);
}

void Append(std::string line)
{
    const std::lock_guard lock(sMutex);
    sCalls += line;
    sCalls += '\n';
}

const char* AllCalls()
{
    const std::lock_guard lock(sMutex);
    sHandedOut = sCalls;
    return sHandedOut.c_str();
}

void ForgetCalls()
{
    const std::lock_guard lock(sMutex);
    sCalls.clear();
}

int LiveObjects()
{
    return sLiveObjects.load();
}

void CountLiveObject(int change)
{
    sLiveObjects.fetch_add(change);
}

} // namespace fixture
