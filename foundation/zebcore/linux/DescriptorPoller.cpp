#include "foundation/zebcore/internal/DescriptorPoller.h"

// Handlers run on the main thread only, and what they are posted with goes through Asio's own lock. The fences that
// this leaves out are unknown to ThreadSanitizer.
#define BOOST_ASIO_DISABLE_FENCED_BLOCK 1

#include <boost/asio/executor_work_guard.hpp>
#include <boost/asio/io_context.hpp>
#include <boost/asio/posix/stream_descriptor.hpp>
#include <boost/asio/post.hpp>

#include <sys/stat.h>

#include <atomic>
#include <map>
#include <utility>

namespace zebcore::threads
{

namespace
{

namespace asio = boost::asio;

/// epoll refuses files and directories, which would be readable for ever.
bool CanBeWatched(int descriptor)
{
    struct stat status = {};
    return fstat(descriptor, &status) == 0 && !S_ISREG(status.st_mode) && !S_ISDIR(status.st_mode);
}

/// A registration of a descriptor with the reactor. A report that is under way for an earlier registration finds its
/// source gone and is dropped.
struct Source
{
    Source(asio::io_context& context, int descriptor, boost::system::error_code& error) : mStream(context)
    {
        mStream.assign(descriptor, error);
    }
    Source(const Source&) = delete;
    Source& operator=(const Source&) = delete;
    ~Source()
    {
        if (mStream.is_open())
            mStream.release();
    }

    asio::posix::stream_descriptor mStream;
    bool mAwaited = false;
};

} // namespace

class DescriptorPoller::Impl
{
public:
    explicit Impl(boost::function<void(int)> report)
        : mReport(std::move(report)), mWork(asio::make_work_guard(mContext))
    {
    }

    bool Register(int descriptor)
    {
        mSources.erase(descriptor);
        if (!CanBeWatched(descriptor))
            return false;
        boost::system::error_code error;
        auto source = std::make_shared<Source>(mContext, descriptor, error);
        if (error)
            return false;
        mSources.emplace(descriptor, std::move(source));
        return true;
    }

    void Await(int descriptor)
    {
        const auto known = mSources.find(descriptor);
        if (known == mSources.end() || std::exchange(known->second->mAwaited, true))
            return;
        // An error and a hang-up end this wait too.
        known->second->mStream.async_wait(
            asio::posix::stream_descriptor::wait_read,
            [this, descriptor, watched = std::weak_ptr<Source>(known->second)](boost::system::error_code error)
            {
                const std::shared_ptr<Source> source = watched.lock();
                if (!source)
                    return;
                source->mAwaited = false;
                if (!error)
                    mReport(descriptor);
            });
    }

    void Forget(int descriptor) { mSources.erase(descriptor); }

    void Poll()
    {
        mContext.restart();
        mContext.poll();
    }

    void Wait(std::chrono::nanoseconds longest)
    {
        mContext.restart();
        mContext.run_one_for(longest);
    }

    void Wake()
    {
        // One is enough, however many calls are queued. Relaxed: the queue has its own lock; this only counts posts.
        if (!mWakePosted.exchange(true, std::memory_order_relaxed))
            asio::post(mContext, [this] { mWakePosted.store(false, std::memory_order_relaxed); });
    }

private:
    boost::function<void(int)> mReport;
    asio::io_context mContext;
    /// Without it a context with nothing to wait for doesn't wait.
    asio::executor_work_guard<asio::io_context::executor_type> mWork;
    std::map<int, std::shared_ptr<Source>> mSources;
    std::atomic<bool> mWakePosted{false};
};

DescriptorPoller::DescriptorPoller(boost::function<void(int)> report)
    : mImpl(std::make_unique<Impl>(std::move(report)))
{
}

DescriptorPoller::~DescriptorPoller() = default;

bool DescriptorPoller::Register(int descriptor)
{
    return mImpl->Register(descriptor);
}

void DescriptorPoller::Await(int descriptor)
{
    mImpl->Await(descriptor);
}

void DescriptorPoller::Forget(int descriptor)
{
    mImpl->Forget(descriptor);
}

void DescriptorPoller::Poll()
{
    mImpl->Poll();
}

void DescriptorPoller::Wait(std::chrono::nanoseconds longest)
{
    mImpl->Wait(longest);
}

void DescriptorPoller::Wake(std::chrono::nanoseconds /*delay*/)
{
    mImpl->Wake();
}

} // namespace zebcore::threads
