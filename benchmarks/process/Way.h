#pragma once

#include "benchmarks/plugins/BenchSide.h"

namespace zebaudiofilterhost::benchmarks
{

/// One way to have an effect of the bundle process blocks. The thread that made it does everything: it is main thread
/// and process thread in turn, so that all of the cost shows and nothing waits.
class Way
{
public:
    virtual ~Way() = default;

    /// One stereo block, in place.
    virtual void Process(float** channels, int frames) = 0;

    /// Sets the parameters from 0 to `count` - 1 ahead of the next block, as an application does from its main
    /// thread.
    virtual void PostChanges(int count, float value) = 0;

    /// What the host's main thread does now and then.
    virtual void Tick() {}

    /// The effect behind it.
    virtual BenchSide& GetSide() = 0;
};

} // namespace zebaudiofilterhost::benchmarks
