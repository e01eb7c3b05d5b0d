#include "host/src/XAU/src/XAUChannelCounts.h"

#include <algorithm>

namespace zebaudiofilterhost::xau
{

namespace
{

constexpr SInt16 kAny = -1;
constexpr SInt16 kAnyOtherThanInput = -2; // as the output beside an input of -1

bool Allows(const AUChannelInfo& pair, const ChannelCounts& requested)
{
    if (pair.inChannels == requested.mInputs && pair.outChannels == requested.mOutputs)
        return true;
    if (pair.inChannels != kAny)
        return false;
    return pair.outChannels == kAnyOtherThanInput ||
           (pair.outChannels == kAny && requested.mInputs == requested.mOutputs);
}

// What a member of a pair comes to for a request: itself, or below -1 at most its absolute value.
SInt16 Effective(SInt16 member, SInt16 requested)
{
    if (member == kAny)
        return requested;
    if (member >= requested || member >= 0)
        return member;
    return static_cast<SInt16>(std::min(int{requested}, -int{member}));
}

ChannelCounts Effective(const AUChannelInfo& pair, const ChannelCounts& requested)
{
    return {Effective(pair.inChannels, requested.mInputs), Effective(pair.outChannels, requested.mOutputs)};
}

bool IsLarger(const ChannelCounts& counts, const ChannelCounts& other)
{
    return counts.mInputs >= other.mInputs && counts.mOutputs >= other.mOutputs && counts != other;
}

} // namespace

ChannelCounts NegotiateChannelCounts(const std::vector<AUChannelInfo>& supported, const ChannelCounts& requested)
{
    if (std::any_of(supported.begin(), supported.end(), [&](const auto& pair) { return Allows(pair, requested); }))
        return requested;

    ChannelCounts best = Effective(supported.front(), requested);
    for (const AUChannelInfo& pair : supported)
    {
        const ChannelCounts counts = Effective(pair, requested);
        if (counts.mInputs >= requested.mInputs && counts.mOutputs >= requested.mOutputs)
            return counts;
    }
    for (const AUChannelInfo& pair : supported)
    {
        const ChannelCounts counts = Effective(pair, requested);
        if (IsLarger(counts, best))
            best = counts;
    }
    return best;
}

} // namespace zebaudiofilterhost::xau
