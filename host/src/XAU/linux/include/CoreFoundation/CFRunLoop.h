#pragma once

#include "CoreFoundation/CFBase.h"

// A thread's loop. That of the main thread runs inside the application's pump of the library's main-thread loop; any
// other thread runs its own with CFRunLoopRunInMode.

enum CFRunLoopRunResult : SInt32
{
    kCFRunLoopRunFinished = 1, // nothing to wait for
    kCFRunLoopRunStopped = 2,
    kCFRunLoopRunTimedOut = 3,
    kCFRunLoopRunHandledSource = 4
};

CF_EXPORT const CFStringRef kCFRunLoopDefaultMode;

/// Lives as long as its thread, and as whoever retains it.
CF_EXPORT CFRunLoopRef CFRunLoopGetCurrent();
/// Runs what is due on the calling thread, and waits for more until the time is over. There is one mode.
CF_EXPORT SInt32 CFRunLoopRunInMode(CFStringRef mode, CFTimeInterval seconds, Boolean returnAfterSourceHandled);
