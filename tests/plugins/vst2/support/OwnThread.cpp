#include "tests/plugins/vst2/support/OwnThread.h"

#include "tests/plugins/support/Recorder.h"

namespace vst2fixture
{

namespace
{

using namespace zebaudiofilterhost::vst;

void CallOnce(const HostAccess& access, unsigned int number)
{
    char text[64] = {};
    access.host(access.effect, audioMasterAutomate, 0, 0, nullptr, static_cast<float>(number % 101) / 100.0F);
    access.host(access.effect, audioMasterGetTime, 0, 0, nullptr, 0.0F);
    access.host(access.effect, audioMasterGetProductString, 0, 0, text, 0.0F);
    access.host(access.effect, audioMasterPinConnected, 0, 1, nullptr, 0.0F);
    access.host(access.effect, audioMasterUpdateDisplay, 0, 0, nullptr, 0.0F);
}

} // namespace

void OwnThread::Start(const HostAccess& access)
{
    Stop();
    mStop = false;
    mThread = std::thread(
        [this, access]
        {
            unsigned int calls = 0;
            do
            {
                CallOnce(access, calls++);
                std::this_thread::yield();
            } while (!mStop);
            fixture::Record("thread.calls", calls);
        });
}

void OwnThread::Stop()
{
    mStop = true;
    if (mThread.joinable())
        mThread.join();
}

} // namespace vst2fixture
