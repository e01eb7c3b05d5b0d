#pragma once

#include "foundation/zebcore/Export.h"

#include <boost/function.hpp>

namespace zebcore::threads
{

using ThreadID = unsigned long long;

/// Identifier of the calling thread, the system's where it has one. Never 0. Asks the system at the first call of a
/// thread only. [any]
ZEB_EXPORT ThreadID GetCurrentThreadID() noexcept;

/// Queues the function to run on the main thread once, after the delay in milliseconds, and ends a wait that the main
/// thread is in. Calls with the same due time run in the order of queueing. The application lets them run: see
/// MainThreadLoop.h. [any but process]
ZEB_EXPORT void AsyncCallFromMainThread(boost::function<void()> function, unsigned int delayMs);

} // namespace zebcore::threads
