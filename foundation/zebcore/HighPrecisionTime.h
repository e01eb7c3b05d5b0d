#pragma once

#include "foundation/zebcore/Export.h"

namespace zebcore::utility
{

/// The platform's high-resolution clock, which never goes back.
class ZEB_EXPORT HighPrecisionTime
{
public:
    /// In ticks of the clock. No system call. [any]
    static unsigned long long GetCurrentTime() noexcept;
    /// Ticks to nanoseconds. [any]
    static unsigned long long ConvertToNanos(unsigned long long ticks) noexcept;
};

} // namespace zebcore::utility
