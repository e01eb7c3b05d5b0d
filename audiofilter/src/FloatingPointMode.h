#pragma once

#include <cstdint>

#if !defined(__aarch64__)
#include <immintrin.h>
#endif

namespace zebaudiofilterhost
{

// Gives the thread back the floating-point mode that it had when the object was made. Plug-ins switch denormal
// numbers off for themselves, and not all of them switch them on again behind a block.
class FloatingPointMode
{
public:
    FloatingPointMode() : mBefore(Get()) {}
    ~FloatingPointMode()
    {
        const Word now = Get();
        if (((now ^ mBefore) & ~kStatus) != 0)
            Set((mBefore & ~kStatus) | (now & kStatus));
    }
    FloatingPointMode(const FloatingPointMode&) = delete;
    FloatingPointMode& operator=(const FloatingPointMode&) = delete;

private:
#if defined(__aarch64__)
    using Word = std::uint64_t;

    static constexpr Word kStatus = 0; // Lies in a register of its own

    static Word Get()
    {
        Word word = 0;
        asm volatile("mrs %0, fpcr" : "=r"(word));
        return word;
    }
    static void Set(Word word)
    {
        asm volatile("msr fpcr, %0" : : "r"(word));
    }
#else
    using Word = std::uint32_t;

    static constexpr Word kStatus = 0x3F; // What computations have met, which is no mode

    static Word Get()
    {
        return _mm_getcsr();
    }
    static void Set(Word word)
    {
        _mm_setcsr(word);
    }
#endif

    Word mBefore;
};

} // namespace zebaudiofilterhost
