#include "foundation/zebaudiodsp/ScalarMath.h"

#include <cmath>

namespace zebaudiodsp
{

float expf(float value) noexcept
{
    return std::exp(value);
}

float logf(float value) noexcept
{
    return std::log(value);
}

double atan(double value) noexcept
{
    return std::atan(value);
}

} // namespace zebaudiodsp
