#pragma once

#include <cstddef>
#include <vector>

namespace zebaudiofilterhost::benchmarks
{

/// Channels of samples, each aligned to a cache line. The signal is never so small that it would be denormal.
class Block
{
public:
    Block(int channels, int frames);
    Block(const Block&) = delete;
    Block& operator=(const Block&) = delete;

    float** GetChannels() { return mChannels.data(); }
    int GetChannelCount() const { return static_cast<int>(mChannels.size()); }
    int GetFrames() const { return mFrames; }

    /// Each sample of a channel differs from its neighbours, and from those of the other channels. Blocks that follow
    /// one another continue each other.
    void Fill(long long firstFrame);
    static float GetSample(int channel, long long frame);

    /// All samples 0.
    void Clear();

private:
    int mFrames;
    std::vector<float> mSamples;
    std::vector<float*> mChannels;
};

} // namespace zebaudiofilterhost::benchmarks
