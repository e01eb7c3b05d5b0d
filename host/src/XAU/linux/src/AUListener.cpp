#include "host/src/XAU/linux/src/AUListener.h"

#include <algorithm>

using namespace zebaudiofilterhost::xau;

namespace
{

constexpr std::chrono::milliseconds kShortestInterval(1);

} // namespace

AUListenerBase::AUListenerBase(AUEventListenerProc proc, void* userData, CFRunLoopRef loop, Seconds interval,
                               Seconds granularity)
    : mProc(proc)
    , mUserData(userData)
    , mLoop(loop)
    , mGranularity(std::chrono::duration_cast<std::chrono::nanoseconds>(granularity))
    , mTimer(
          loop->AddTimer(std::max(kShortestInterval, std::chrono::duration_cast<std::chrono::milliseconds>(interval)),
                         [this] { Deliver(); }))
{
}

AUListenerBase::~AUListenerBase()
{
    mLoop->RemoveTimer(mTimer);
    *mIsAlive = false;
}

void AUListenerBase::Tell(const Told& told)
{
    if (!mTold.bounded_push(told))
        mHasLost.store(true, std::memory_order_relaxed); // read again at the next pass, whenever that is
}

std::vector<Told> AUListenerBase::Collect()
{
    std::vector<Told> batch;
    mTold.consume_all([&](const Told& told) { batch.push_back(told); });
    if (mHasLost.exchange(false, std::memory_order_relaxed))
        AddLost(batch);
    return batch;
}

// What was lost may have been about anything: all values are heard once more.
void AUListenerBase::AddLost(std::vector<Told>& batch) const
{
    for (const Interest& interest : mInterests)
    {
        if (interest.mEvent.mEventType != kAudioUnitEvent_ParameterValueChange)
            continue;
        const AudioUnitParameter& parameter = interest.mEvent.mArgument.mParameter;
        Told told{interest, batch.empty() ? 0 : batch.back().mHostTime, 0};
        if (AudioUnitGetParameter(parameter.mAudioUnit, parameter.mParameterID, parameter.mScope, parameter.mElement,
                                  &told.mValue) == noErr)
            batch.push_back(told);
    }
}

bool AUListenerBase::IsSuperseded(const std::vector<Told>& batch, std::size_t index) const
{
    const Told& told = batch[index];
    if (told.mInterest.mEvent.mEventType != kAudioUnitEvent_ParameterValueChange)
        return false;
    for (std::size_t later = index + 1; later < batch.size(); ++later)
    {
        const Told& next = batch[later];
        if (next.mInterest.mEvent.mEventType != kAudioUnitEvent_ParameterValueChange)
            return false; // a gesture begins or ends: what was changed before it is heard before it
        if (next.mInterest == told.mInterest)
            return std::chrono::nanoseconds(next.mHostTime - told.mHostTime) < mGranularity;
    }
    return false;
}

void AUListenerBase::Deliver()
{
    const std::vector<Told> batch = Collect();
    const std::shared_ptr<bool> isAlive = mIsAlive;
    for (std::size_t index = 0; index < batch.size(); ++index)
    {
        const Told& told = batch[index];
        const bool isWanted = std::find(mInterests.begin(), mInterests.end(), told.mInterest) != mInterests.end();
        if (!isWanted || IsSuperseded(batch, index))
            continue;
        mProc(mUserData, told.mInterest.mObject, &told.mInterest.mEvent, told.mHostTime, told.mValue);
        if (!*isAlive)
            return;
    }
}
