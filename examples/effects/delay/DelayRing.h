#pragma once

#include <cstddef>
#include <vector>

namespace effects::delay
{

// The last so many samples of one channel.
class DelayRing
{
public:
    void Resize(std::size_t longest) { mSamples.assign(longest + 1, 0.0F); }

    void Push(float sample)
    {
        mNewest = mNewest + 1 < mSamples.size() ? mNewest + 1 : 0;
        mSamples[mNewest] = sample;
    }

    // 0 is the sample just pushed; at most what Resize was given.
    float Ago(std::size_t samples) const
    {
        return mSamples[mNewest >= samples ? mNewest - samples : mNewest + mSamples.size() - samples];
    }

private:
    std::vector<float> mSamples{0.0F};
    std::size_t mNewest = 0;
};

} // namespace effects::delay
