#pragma once

#include "foundation/zebcore/Export.h"

#include <boost/function.hpp>

namespace zebcore::threads
{

// What the main thread does between the application's own work: delayed calls (AsyncCallFromMainThread), repeating
// timers and watched descriptors. No thread is started: everything runs inside the two operations below. On macOS the
// main run loop does the same without them.
//
// Handlers may add and remove watches, queue calls and pump again; a handler is not entered a second time while it
// runs. What a handler throws reaches the caller of the pump, and what was still to do is done by the next one.

/// Runs what is due now, and returns without waiting. What a handler queues waits for the next pump, even with no
/// delay. True when something ran. [main]
ZEB_EXPORT bool PumpMainThread();

/// Pumps, and waits for work between, until done() is true or the time is over; pumps at least once. An empty done
/// runs to the end of the time. Returns whether done() was true. [main]
ZEB_EXPORT bool RunMainThreadUntil(const boost::function<bool()>& done, unsigned int timeoutMs);

/// Names one watch. Never given twice in a process.
using WatchID = unsigned long long;
inline constexpr WatchID kNoWatch = 0;

/// Calls the handler whenever the descriptor is readable, has an error or has been hung up, for as long as that is
/// so. A descriptor may have several watches, also with the same handler; they are called in the order of adding. The
/// descriptor stays the caller's, blocking or not, and is to be closed after its watches have been removed. kNoWatch
/// when it can't be watched. [main]
ZEB_EXPORT WatchID AddDescriptorWatch(int descriptor, boost::function<void(int descriptor)> handler);
/// The handler is not called again. Does nothing if there is no such watch. [main]
ZEB_EXPORT void RemoveDescriptorWatch(WatchID watch);

/// Calls the handler every periodMs milliseconds, first after one period. A period of 0 counts as 1. Calls that the
/// main thread was too late for are left out. [main]
ZEB_EXPORT WatchID AddTimerWatch(unsigned int periodMs, boost::function<void()> handler);
/// The handler is not called again. Does nothing if there is no such watch. [main]
ZEB_EXPORT void RemoveTimerWatch(WatchID watch);

/// For tests: the clock, in nanoseconds, that decides what is due. What is queued keeps the time it still has to
/// wait. While a clock is set, nothing ever sleeps. An empty function restores the real clock. [main]
ZEB_EXPORT void SetMainThreadClock(const boost::function<unsigned long long()>& nanos);

} // namespace zebcore::threads
