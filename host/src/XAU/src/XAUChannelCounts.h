#pragma once

#include <AudioToolbox/AudioToolbox.h>

#include <vector>

namespace zebaudiofilterhost::xau
{

struct ChannelCounts
{
    SInt16 mInputs;
    SInt16 mOutputs;

    bool operator==(const ChannelCounts&) const = default;
};

/// Which of the counts that a unit supports serve a request best: the request itself where a pair allows it, else the
/// first pair that has room for it, else the largest pair. `supported` must not be empty. [any]
ChannelCounts NegotiateChannelCounts(const std::vector<AUChannelInfo>& supported, const ChannelCounts& requested);

} // namespace zebaudiofilterhost::xau
