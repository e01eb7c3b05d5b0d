#pragma once

#include "benchmarks/peer/PeerFilter.h"
#include "benchmarks/process/Way.h"

#include <string>

namespace zebaudiofilterhost::benchmarks
{

/// The effect in the peer host.
class PeerWay final : public Way
{
public:
    /// Throws std::runtime_error when the effect does not come up.
    PeerWay(const std::string& effect, int frames);

    void Process(float** channels, int frames) override;
    void PostChanges(int count, float value) override;
    BenchSide& GetSide() override { return *mSide; }

private:
    PeerFilter mFilter;
    BenchSide* mSide = nullptr;
};

} // namespace zebaudiofilterhost::benchmarks
