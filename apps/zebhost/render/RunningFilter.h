#pragma once

#include <audiofilter/AudioFilter.h>

namespace zebhost
{

// A filter that is running for as long as this lives. [main]
class RunningFilter
{
public:
    // The filter is configured, suspended, and outlives this.
    RunningFilter(zebaudiofilterhost::AudioFilter& filter, int sampleRate, unsigned int settleMs);
    ~RunningFilter();
    RunningFilter(const RunningFilter&) = delete;
    RunningFilter& operator=(const RunningFilter&) = delete;

    static constexpr int kLongestSeconds = 60;

    // In frames, for at most kLongestSeconds: the one that the filter's delay line is made for. A latency that nobody
    // can mean counts as 0, as it does there.
    int Latency() const { return mLatency; }

private:
    void AgreeOnLatency();

    zebaudiofilterhost::AudioFilter& mFilter;
    int mLatency = 0;
};

} // namespace zebhost
