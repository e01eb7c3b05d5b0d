#pragma once

#include "audiofilter/AudioFilter.h"

#include <utility>
#include <vector>

namespace realtimeproof
{

using namespace zebaudiofilterhost;

// A filter of one technology, and the traffic that only this technology has.
class Subject
{
public:
    // `channels`: of the plug-in, each way, for one stretch of processing after the other.
    Subject(boost::intrusive_ptr<AudioFilter> filter, std::vector<int> channels)
        : mFilter(std::move(filter)), mChannels(std::move(channels))
    {
    }
    virtual ~Subject() = default;
    Subject(const Subject&) = delete;
    Subject& operator=(const Subject&) = delete;

    AudioFilter& Filter() const { return *mFilter; }
    const std::vector<int>& Channels() const { return mChannels; }

    // While audio runs: on the main thread, and on a thread that the filter does not know. The second tells of
    // changed parameters.
    virtual void WorkOnMain(int /*round*/) {}
    virtual void WorkElsewhere(int round) = 0;

protected:
    static float ValueOf(int round) { return static_cast<float>(1 + round % 100) / 100.0F; }

private:
    boost::intrusive_ptr<AudioFilter> mFilter;
    std::vector<int> mChannels;
};

} // namespace realtimeproof
