#include "foundation/zebaccelerate/FloatBuffer.h"
#include "foundation/zebaudiodsp/ScalarMath.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <vector>

namespace accelerate = zebaccelerate::utility;

namespace
{

TEST(FloatBuffer, IsAlignedAndWritable)
{
    for (const unsigned int count : {0U, 1U, 7U, 4096U})
    {
        float* buffer = accelerate::Malloc_Float(count);
        ASSERT_NE(nullptr, buffer);
        EXPECT_EQ(0U, reinterpret_cast<std::uintptr_t>(buffer) % 64);
        accelerate::Zero(count, buffer);
        accelerate::Free(buffer);
    }
    accelerate::Free(nullptr);
}

TEST(FloatBuffer, CopyAndZeroKeepToTheirCount)
{
    const std::vector<float> source{1, 2, 3, 4};
    std::vector<float> target{9, 9, 9, 9};
    accelerate::Copy(3, source.data(), target.data());
    EXPECT_EQ((std::vector<float>{1, 2, 3, 9}), target);
    accelerate::Zero(2, target.data());
    EXPECT_EQ((std::vector<float>{0, 0, 3, 9}), target);
    accelerate::Copy(0, nullptr, nullptr);
    accelerate::Zero(0, nullptr);
}

TEST(ScalarMath, ComputesInThePrecisionOfItsArgument)
{
    EXPECT_FLOAT_EQ(1000.0F, zebaudiodsp::expf(zebaudiodsp::logf(1000.0F)));
    EXPECT_DOUBLE_EQ(0.78539816339744828, zebaudiodsp::atan(1.0));
}

} // namespace
