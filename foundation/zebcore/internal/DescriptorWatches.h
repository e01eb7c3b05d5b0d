#pragma once

#include "foundation/zebcore/MainThreadLoop.h"
#include "foundation/zebcore/internal/DescriptorPoller.h"

#include <boost/function.hpp>

#include <deque>
#include <map>
#include <memory>
#include <vector>

namespace zebcore::threads
{

/// The watches of the main-thread loop, several of which may share a descriptor. Internal to the loop. Main thread.
class DescriptorWatches
{
public:
    using Handler = boost::function<void(int descriptor)>;

    explicit DescriptorWatches(DescriptorPoller& poller);

    WatchID Add(int descriptor, Handler handler);
    void Remove(WatchID watch);

    /// A descriptor is ready: each of its watches gets a turn.
    void OnReady(int descriptor);
    /// Runs the turns that were there before this call. True when a handler was called.
    bool RunTurns();
    bool HasTurns() const;

private:
    struct Watch
    {
        WatchID mID;
        Handler mHandler;
        bool mRemoved = false;
    };
    struct Descriptor
    {
        int mNumber;
        std::vector<std::shared_ptr<Watch>> mWatches;
        int mTurns = 0; ///< Waiting or running.
    };
    struct Turn
    {
        std::shared_ptr<Descriptor> mDescriptor;
        std::shared_ptr<Watch> mWatch;
    };
    class TurnEnd;

    bool IsWatched(const Descriptor& descriptor) const;

    DescriptorPoller& mPoller;
    std::map<int, std::shared_ptr<Descriptor>> mDescriptors;
    std::deque<Turn> mTurns;
};

} // namespace zebcore::threads
