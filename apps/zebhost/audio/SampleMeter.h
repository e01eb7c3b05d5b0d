#pragma once

#include <cstdint>
#include <vector>

namespace zebhost
{

// What goes through it: the highest level, and samples that are infinite or no number, which it makes 0.
class SampleMeter
{
public:
    void Take(std::vector<float>& samples);

    float Peak() const { return mPeak; }
    std::int64_t BrokenSamples() const { return mBroken; }

private:
    float mPeak = 0;
    std::int64_t mBroken = 0;
};

} // namespace zebhost
