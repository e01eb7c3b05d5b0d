#include "foundation/zebcore/internal/DescriptorWatches.h"

#include "foundation/zebcore/internal/MainThreadQueue.h"

#include <algorithm>
#include <utility>

namespace zebcore::threads
{

/// Ends a turn, also when its handler throws. A descriptor is polled again when all of its turns are over, so that no
/// handler is called a second time while it runs.
class DescriptorWatches::TurnEnd
{
public:
    TurnEnd(DescriptorWatches& watches, Descriptor& descriptor) : mWatches(watches), mDescriptor(descriptor) {}
    TurnEnd(const TurnEnd&) = delete;
    TurnEnd& operator=(const TurnEnd&) = delete;
    ~TurnEnd()
    {
        --mDescriptor.mTurns;
        if (mDescriptor.mTurns == 0 && mWatches.IsWatched(mDescriptor))
            mWatches.mPoller.Await(mDescriptor.mNumber);
    }

private:
    DescriptorWatches& mWatches;
    Descriptor& mDescriptor;
};

DescriptorWatches::DescriptorWatches(DescriptorPoller& poller) : mPoller(poller)
{
}

WatchID DescriptorWatches::Add(int descriptor, Handler handler)
{
    if (!mPoller.Register(descriptor))
        return kNoWatch;

    auto& known = mDescriptors[descriptor];
    if (!known)
        known = std::make_shared<Descriptor>(Descriptor{descriptor, {}});
    known->mWatches.push_back(std::make_shared<Watch>(Watch{NextWatchID(), std::move(handler)}));
    if (known->mTurns == 0)
        mPoller.Await(descriptor);
    return known->mWatches.back()->mID;
}

void DescriptorWatches::Remove(WatchID watch)
{
    for (const auto& [number, descriptor] : mDescriptors)
    {
        auto& watches = descriptor->mWatches;
        const auto found = std::find_if(watches.begin(), watches.end(),
                                        [&](const auto& candidate) { return candidate->mID == watch; });
        if (found == watches.end())
            continue;

        const std::shared_ptr<Watch> removed = *found; // Dies last: its handler may remove other watches as it goes.
        removed->mRemoved = true;
        watches.erase(found);
        if (watches.empty())
        {
            mPoller.Forget(number);
            mDescriptors.erase(number);
        }
        return;
    }
}

void DescriptorWatches::OnReady(int descriptor)
{
    const auto known = mDescriptors.find(descriptor);
    if (known == mDescriptors.end() || known->second->mTurns != 0)
        return;
    for (const auto& watch : known->second->mWatches)
        mTurns.push_back({known->second, watch});
    known->second->mTurns = static_cast<int>(known->second->mWatches.size());
}

bool DescriptorWatches::RunTurns()
{
    bool ran = false;
    for (std::size_t count = mTurns.size(); count > 0 && !mTurns.empty(); --count)
    {
        const Turn turn = std::move(mTurns.front());
        mTurns.pop_front();
        const TurnEnd end(*this, *turn.mDescriptor);
        if (turn.mWatch->mRemoved)
            continue;
        ran = true;
        turn.mWatch->mHandler(turn.mDescriptor->mNumber);
    }
    return ran;
}

bool DescriptorWatches::HasTurns() const
{
    return !mTurns.empty();
}

bool DescriptorWatches::IsWatched(const Descriptor& descriptor) const
{
    const auto known = mDescriptors.find(descriptor.mNumber);
    return known != mDescriptors.end() && known->second.get() == &descriptor;
}

} // namespace zebcore::threads
