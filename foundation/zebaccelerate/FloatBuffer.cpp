#include "foundation/zebaccelerate/FloatBuffer.h"

#include <cstddef>
#include <cstring>
#include <new>

namespace zebaccelerate::utility
{

namespace
{

/// A cache line, and enough for any vector instruction.
constexpr std::align_val_t kAlignment{64};

} // namespace

float* Malloc_Float(unsigned int count) noexcept
{
    static_assert(sizeof(std::size_t) > sizeof(count), "the size in bytes of any count can be told");
    return static_cast<float*>(::operator new (std::size_t{count} * sizeof(float), kAlignment, std::nothrow));
}

void Free(float* buffer) noexcept
{
    ::operator delete(buffer, kAlignment);
}

void Copy(unsigned int count, const float* source, float* target) noexcept
{
    if (count != 0)
        std::memcpy(target, source, std::size_t{count} * sizeof(float));
}

void Zero(unsigned int count, float* target) noexcept
{
    // All bits zero is the float 0.
    if (count != 0)
        std::memset(target, 0, std::size_t{count} * sizeof(float));
}

} // namespace zebaccelerate::utility
