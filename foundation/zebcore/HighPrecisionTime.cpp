#include "foundation/zebcore/HighPrecisionTime.h"

#include <chrono>

namespace zebcore::utility
{

namespace
{

using Clock = std::chrono::steady_clock;

} // namespace

unsigned long long HighPrecisionTime::GetCurrentTime() noexcept
{
    return static_cast<unsigned long long>(Clock::now().time_since_epoch().count());
}

unsigned long long HighPrecisionTime::ConvertToNanos(unsigned long long ticks) noexcept
{
    using Ticks = std::chrono::duration<unsigned long long, Clock::period>;
    using Nanos = std::chrono::duration<unsigned long long, std::nano>;
    return std::chrono::duration_cast<Nanos>(Ticks(ticks)).count();
}

} // namespace zebcore::utility
