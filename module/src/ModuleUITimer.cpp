#include "module/ModuleUITimer.h"

#include "foundation/zebcore/Threads.h"

#include <boost/signals2/signal.hpp>

namespace zebaudiofilterhost
{

namespace
{

constexpr unsigned int kTickDelayMs = 20;

} // namespace

class ModuleUITimer::Impl
{
public:
    boost::signals2::connection ConnectTick(const boost::signals2::slot<void()>& slot)
    {
        boost::signals2::connection connection = mTickSignal.connect(slot);
        if (!mRunning)
            QueueTick();
        return connection;
    }

private:
    void QueueTick()
    {
        mRunning = true;
        zebcore::threads::AsyncCallFromMainThread([this] { OnTimeElapsed(); }, kTickDelayMs);
    }

    void OnTimeElapsed()
    {
        if (mTickSignal.empty())
        {
            mRunning = false;
            return;
        }
        try
        {
            mTickSignal();
        }
        catch (...)
        {
            QueueTick(); // One slot's failure must not stop the clock of all filters
            throw;
        }
        QueueTick();
    }

    boost::signals2::signal<void()> mTickSignal;
    bool mRunning = false; // A tick is queued; main thread only
};

ModuleUITimer::ModuleUITimer() : mImpl(std::make_unique<Impl>())
{
}

ModuleUITimer::~ModuleUITimer() = default;

ModuleUITimer& ModuleUITimer::GetInstance()
{
    static ModuleUITimer sInstance;
    return sInstance;
}

boost::signals2::connection ModuleUITimer::ConnectTick(const boost::signals2::slot<void()>& slot)
{
    return mImpl->ConnectTick(slot);
}

} // namespace zebaudiofilterhost
