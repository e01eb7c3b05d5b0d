// What the nets of the guard share.
#pragma once

#include "tests/support/RealtimeGuard.h"

#if defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer) || __has_feature(memory_sanitizer)
#define ZEB_GUARD_SANITIZED 1
#endif
#endif
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define ZEB_GUARD_SANITIZED 1
#endif

#if defined(__linux__) && defined(__x86_64__) && defined(__GLIBC__) && !defined(ZEB_GUARD_SANITIZED)
#define ZEB_GUARD_INTERPOSES 1
#else
#define ZEB_GUARD_INTERPOSES 0
#endif

namespace realtimeguard
{

/// Counts a violation if the calling thread is in a section. Safe anywhere: neither allocates nor locks.
void Record(Violation violation) noexcept;

/// Counts what the kernel has counted on the calling thread.
void RecordUsage(Violation violation, long count) noexcept;

/// Arms and disarms the net for the system calls of the calling thread.
void ArmSystemCallTrap() noexcept;
void DisarmSystemCallTrap() noexcept;

} // namespace realtimeguard
