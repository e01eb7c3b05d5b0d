#include "audio/SampleMeter.h"

#include <algorithm>
#include <cmath>

namespace zebhost
{

void SampleMeter::Take(std::vector<float>& samples)
{
    for (float& sample : samples)
    {
        if (!std::isfinite(sample))
        {
            sample = 0;
            ++mBroken;
        }
        mPeak = std::max(mPeak, std::abs(sample));
    }
}

} // namespace zebhost
