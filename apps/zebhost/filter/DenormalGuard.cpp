#include "filter/DenormalGuard.h"

#include <immintrin.h>

namespace zebhost
{

namespace
{

constexpr unsigned int kFlushToZero = 0x8000;
constexpr unsigned int kDenormalsAreZero = 0x0040;

} // namespace

DenormalGuard::DenormalGuard() : mPrevious(_mm_getcsr())
{
    _mm_setcsr(mPrevious | kFlushToZero | kDenormalsAreZero);
}

DenormalGuard::~DenormalGuard()
{
    _mm_setcsr(mPrevious);
}

} // namespace zebhost
