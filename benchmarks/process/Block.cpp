#include "benchmarks/process/Block.h"

#include <algorithm>
#include <memory>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

constexpr std::size_t kAlignment = 64;
constexpr std::size_t kFloatsOfLine = kAlignment / sizeof(float);

} // namespace

Block::Block(int channels, int frames) : mFrames(frames)
{
    // A line between channels keeps those of large blocks out of the same sets of the cache.
    const std::size_t stride =
        (static_cast<std::size_t>(frames) + kFloatsOfLine - 1) / kFloatsOfLine * kFloatsOfLine + kFloatsOfLine;
    mSamples.resize(stride * static_cast<std::size_t>(channels) + kFloatsOfLine);
    void* start = mSamples.data();
    std::size_t space = mSamples.size() * sizeof(float);
    auto* const samples = static_cast<float*>(std::align(kAlignment, kAlignment, start, space));
    for (int channel = 0; channel < channels; ++channel)
        mChannels.push_back(samples + static_cast<std::size_t>(channel) * stride);
}

void Block::Fill(long long firstFrame)
{
    for (int channel = 0; channel < GetChannelCount(); ++channel)
        for (int frame = 0; frame < mFrames; ++frame)
            mChannels[static_cast<std::size_t>(channel)][frame] = GetSample(channel, firstFrame + frame);
}

float Block::GetSample(int channel, long long frame)
{
    // Exact in a float, from 1 to 2^20, with a period that no ring shares.
    constexpr long long kPeriod = 65521;
    return static_cast<float>(1 + channel + 16 * (frame % kPeriod));
}

void Block::Clear()
{
    std::fill(mSamples.begin(), mSamples.end(), 0.0F);
}

} // namespace zebaudiofilterhost::benchmarks
