#pragma once

#include <concepts>

namespace zebcore::utility
{

/// Set of flags over an unsigned integer, which converts to the set of its bits. Default empty.
template <std::unsigned_integral T>
class Flags
{
public:
    constexpr Flags() = default;
    constexpr Flags(T value) : mValue(value) {} // NOLINT(google-explicit-constructor)

    constexpr T Value() const { return mValue; }
    /// True when any flag of the mask is set.
    constexpr bool IsSet(T mask) const { return (mValue & mask) != 0; }
    constexpr void Set(T mask) { mValue = static_cast<T>(mValue | mask); }
    constexpr void Clear(T mask) { mValue = static_cast<T>(mValue & static_cast<T>(~mask)); }

    constexpr Flags& operator|=(Flags other)
    {
        Set(other.mValue);
        return *this;
    }
    constexpr bool operator==(const Flags&) const = default;

private:
    T mValue = 0;
};

} // namespace zebcore::utility
