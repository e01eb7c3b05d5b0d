#include "render/RunningFilter.h"

#include "filter/LoadFilter.h"

namespace zebhost
{

RunningFilter::RunningFilter(zebaudiofilterhost::AudioFilter& filter, int sampleRate, unsigned int settleMs)
    : mFilter(filter)
{
    mFilter.Resume();
    Settle(settleMs);
    AgreeOnLatency();
    const bool credible = mLatency >= 0 && mLatency / kLongestSeconds <= sampleRate;
    mLatency = credible ? mLatency : 0;
}

RunningFilter::~RunningFilter()
{
    mFilter.Suspend();
}

// A plug-in may tell another latency once it is active, or announce one from a timer, while the delay line is made
// for what was known before: so the filter is started again until both agree.
void RunningFilter::AgreeOnLatency()
{
    constexpr int kMostAttempts = 4;
    mLatency = mFilter.GetInitialDelay();
    for (int attempt = 0; attempt < kMostAttempts; ++attempt)
    {
        const int before = mLatency;
        mFilter.Suspend();
        mFilter.Resume();
        mLatency = mFilter.GetInitialDelay();
        if (mLatency == before)
        {
            return;
        }
    }
}

} // namespace zebhost
