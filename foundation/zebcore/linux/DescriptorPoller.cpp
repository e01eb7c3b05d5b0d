#include "foundation/zebcore/internal/DescriptorPoller.h"

// Handlers run on the main thread only, and what they are posted with goes through Asio's own lock. The fences that
// this leaves out are unknown to ThreadSanitizer.
#define BOOST_ASIO_DISABLE_FENCED_BLOCK 1

#include <boost/asio/executor_work_guard.hpp>
#include <boost/asio/io_context.hpp>
#include <boost/asio/posix/stream_descriptor.hpp>
#include <boost/asio/post.hpp>

#include <poll.h>
#include <sys/epoll.h>
#include <unistd.h>

#include <atomic>
#include <map>
#include <utility>

namespace zebcore::threads
{

namespace
{

namespace asio = boost::asio;

/// What was seen may have been read by now, or belong to an open file that has lost this number to another one.
bool IsReady(int descriptor)
{
    pollfd state{descriptor, POLLIN, 0};
    return poll(&state, 1, 0) > 0 && (state.revents & POLLNVAL) == 0;
}

/// A descriptor that is watched, by an epoll instance of its own, which Asio waits for. To wait for the descriptor
/// itself Asio would make it non-blocking, and that for everybody who shares the open file. The instance refuses what
/// can't be watched, and with it goes all that it has seen, even if the descriptor was closed and a duplicate lives
/// on. A report that is under way for an earlier registration finds its source gone and is dropped.
class Source
{
public:
    explicit Source(asio::io_context& context) : mStream(context) {}
    Source(const Source&) = delete;
    Source& operator=(const Source&) = delete;
    ~Source()
    {
        // Closing alone would leave it with Asio if a process that was forked off still has it.
        if (mStream.is_open())
            close(mStream.release());
    }

    bool Open(int descriptor)
    {
        const int instance = epoll_create1(EPOLL_CLOEXEC);
        if (instance < 0)
            return false;
        boost::system::error_code error;
        mStream.assign(instance, error);
        if (error)
        {
            close(instance);
            return false;
        }
        epoll_event event{};
        event.events = EPOLLIN; // errors and hang-ups come unasked
        return epoll_ctl(instance, EPOLL_CTL_ADD, descriptor, &event) == 0;
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
        auto source = std::make_shared<Source>(mContext);
        if (!source->Open(descriptor))
            return false;
        mSources.emplace(descriptor, std::move(source));
        return true;
    }

    void Await(int descriptor)
    {
        const auto known = mSources.find(descriptor);
        if (known == mSources.end() || std::exchange(known->second->mAwaited, true))
            return;
        known->second->mStream.async_wait(
            asio::posix::stream_descriptor::wait_read,
            [this, descriptor, watched = std::weak_ptr<Source>(known->second)](boost::system::error_code error)
            {
                const std::shared_ptr<Source> source = watched.lock();
                if (!source)
                    return;
                source->mAwaited = false;
                if (error)
                    return;
                if (IsReady(descriptor))
                    mReport(descriptor);
                else if (Register(descriptor))
                    Await(descriptor);
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
