#include "benchmarks/process/PeerWay.h"

#include "benchmarks/process/BenchBundle.h"

#include <stdexcept>

namespace zebaudiofilterhost::benchmarks
{

PeerWay::PeerWay(const std::string& effect, int frames)
{
    if (!mFilter.Load(BenchBundle::GetPath(), effect))
        throw std::runtime_error("the peer has no " + effect + ": " + mFilter.GetError());
    mSide = &BenchBundle::GetInstance().GetLatestSide();
    mFilter.Prepare(kSampleRate, frames);
}

void PeerWay::Process(float** channels, int frames)
{
    mFilter.Process(channels, 2, frames);
}

void PeerWay::PostChanges(int count, float value)
{
    for (int index = 0; index < count; ++index)
        mFilter.SetParameter(index, value);
}

} // namespace zebaudiofilterhost::benchmarks
