#pragma once

#include <pluginterfaces/base/ftypes.h>

namespace zebaudiofilterhost::vst3
{

/// One point of a parameter's course through a block.
struct ParameterQueueValue
{
    double mValue = 0;                  // normalised
    Steinberg::int32 mSampleOffset = 0; // from the start of the block
};

/// How many changes of one parameter wait for a block at most, and how many points a queue holds without allocating.
inline constexpr Steinberg::int32 kMaxPointsPerParameter = 100;

} // namespace zebaudiofilterhost::vst3
