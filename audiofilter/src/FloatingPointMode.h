#pragma once

#include <immintrin.h>

namespace zebaudiofilterhost
{

// Gives the thread back the floating-point mode that it had when the object was made. Plug-ins switch denormal
// numbers off for themselves, and not all of them switch them on again behind a block.
class FloatingPointMode
{
public:
    FloatingPointMode() : mBefore(_mm_getcsr()) {}
    ~FloatingPointMode()
    {
        const unsigned int now = _mm_getcsr();
        if (((now ^ mBefore) & ~kStatus) != 0)
            _mm_setcsr((mBefore & ~kStatus) | (now & kStatus));
    }
    FloatingPointMode(const FloatingPointMode&) = delete;
    FloatingPointMode& operator=(const FloatingPointMode&) = delete;

private:
    static constexpr unsigned int kStatus = 0x3F; // What computations have met, which is no mode

    unsigned int mBefore;
};

} // namespace zebaudiofilterhost
