// Catches what the process thread must not do: allocate, free, lock, call the system.
#pragma once

#include <string>

namespace realtimeguard
{

enum class Violation
{
    Allocation,
    Free,
    Lock,
    SystemCall
};

/// While one lives, forbidden calls of its thread are counted; they are carried out all the same. Sections nest. Put
/// one around each block: of the system calls of a section only the first is seen.
class Section
{
public:
    Section();
    ~Section();

    Section(const Section&) = delete;
    Section& operator=(const Section&) = delete;
};

/// Whether allocations, frees and locks are seen. Not with sanitizers, which bring their own allocator.
bool IsActive();

/// Whether system calls are seen on the calling thread; the kernel must be able to hand them over (Linux 5.11).
bool CatchesSystemCalls();

/// Says on stderr, once in a process, what this build or this kernel can't see. True if all is seen.
bool AnnounceWhatIsMissing();

/// Violations in all sections of all threads since the last Reset.
unsigned long Count(Violation violation);
unsigned long CountAll();

/// The counts, and the call stacks of the first few violations.
std::string Report();

void Reset();

} // namespace realtimeguard
