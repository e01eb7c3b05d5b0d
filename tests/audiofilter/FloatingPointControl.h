// The word of the processor that says how this thread computes with floating-point numbers.
#pragma once

#include <cstdint>

#if !defined(__aarch64__)
#include <immintrin.h>
#endif

namespace zebaudiofilterhost::testing
{

#if defined(__aarch64__)

constexpr std::uint64_t kFloatingPointModes = ~std::uint64_t(0);
constexpr std::uint64_t kFlushAndRoundDown = (1U << 24) | (2U << 22);

inline std::uint64_t GetFloatingPointWord()
{
    std::uint64_t word = 0;
    asm volatile("mrs %0, fpcr" : "=r"(word));
    return word;
}

inline void SetFloatingPointWord(std::uint64_t word)
{
    asm volatile("msr fpcr, %0" : : "r"(word));
}

#else

constexpr std::uint32_t kFloatingPointModes = ~0x3FU;
constexpr std::uint32_t kFlushAndRoundDown = 0x8040U | 0x2000U;

inline std::uint32_t GetFloatingPointWord()
{
    return _mm_getcsr();
}

inline void SetFloatingPointWord(std::uint32_t word)
{
    _mm_setcsr(word);
}

#endif

inline auto GetFloatingPointMode()
{
    return GetFloatingPointWord() & kFloatingPointModes;
}

// Puts the thread's word back at the end of a test.
class FloatingPointRestorer
{
public:
    FloatingPointRestorer() : mBefore(GetFloatingPointWord()) {}
    ~FloatingPointRestorer() { SetFloatingPointWord(mBefore); }
    FloatingPointRestorer(const FloatingPointRestorer&) = delete;
    FloatingPointRestorer& operator=(const FloatingPointRestorer&) = delete;

private:
    decltype(GetFloatingPointWord()) mBefore;
};

} // namespace zebaudiofilterhost::testing
