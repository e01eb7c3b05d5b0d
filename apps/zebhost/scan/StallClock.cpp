#include "scan/StallClock.h"

#include <algorithm>

namespace zebhost
{

StallClock::StallClock(double seconds) : mLimit(seconds)
{
}

void StallClock::Restart()
{
    mCounted = std::chrono::duration<double>::zero();
    mLast = Clock::now();
}

void StallClock::Tick()
{
    constexpr std::chrono::duration<double> kLongestTick{0.25};
    const Clock::time_point now = Clock::now();
    mCounted += std::min<std::chrono::duration<double>>(now - mLast, kLongestTick);
    mLast = now;
}

bool StallClock::HasExpired() const
{
    return mLimit.count() > 0 && mCounted >= mLimit;
}

} // namespace zebhost
