#include "tests/plugins/support/OwnThread.h"

#include "tests/plugins/support/Behaviour.h"
#include "tests/plugins/support/HostAccess.h"
#include "tests/plugins/support/Recorder.h"

namespace fixture
{

void OwnThread::Start()
{
    Stop();
    if (!IsOn(Knob::kThreadEdits) && !IsOn(Knob::kThreadRestarts))
        return;
    mStop = false;
    mThread = std::thread([this] { Run(); });
}

void OwnThread::Stop()
{
    mStop = true;
    if (mThread.joinable())
        mThread.join();
}

void OwnThread::Run()
{
    unsigned int calls = 0;
    while (!mStop)
    {
        IComponentHandler* handler = Handler();
        if (handler != nullptr && IsOn(Knob::kThreadEdits))
            handler->performEdit(kAmount, (calls % 101) / 100.0);
        if (handler != nullptr && IsOn(Knob::kThreadRestarts))
            handler->restartComponent(GetInt(Knob::kThreadRestarts));
        ++calls;
        std::this_thread::yield();
    }
    Record("thread.calls", calls);
}

} // namespace fixture
