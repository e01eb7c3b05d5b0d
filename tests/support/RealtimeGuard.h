// Catches what the process thread must not do: allocate, free, lock, call the system, fault, give way.
#pragma once

#include <string>

namespace realtimeguard
{

enum class Violation
{
    Allocation,
    Free,
    Lock,
    SystemCall,
    PageFault,
    VoluntarySwitch
};

/// While one lives, forbidden calls of its thread are counted: allocations, frees, locks, system calls. They are
/// carried out all the same. Sections nest. Put one around each block: of the system calls of a section only the
/// first is seen.
class Section
{
public:
    Section();
    ~Section();

    Section(const Section&) = delete;
    Section& operator=(const Section&) = delete;
};

/// When one ends, the page faults and voluntary context switches of its thread since its begin are counted, by the
/// kernel's account. Put one around all blocks of a run, outside their Sections: asking the kernel is a system call.
class UsageSection
{
public:
    UsageSection();
    ~UsageSection();

    UsageSection(const UsageSection&) = delete;
    UsageSection& operator=(const UsageSection&) = delete;

private:
    [[maybe_unused]] long mFaults;
    [[maybe_unused]] long mSwitches;
};

/// What a careful application does ahead of its first block. The process: reads every page of code and constants that
/// is loaded, and tells the kernel not to move its memory into larger pages. The thread: touches the stack that it is
/// going to need, and readies the nets. Memory that the library keeps for its blocks is not touched.
void PrepareProcess();
void PrepareThread();

/// Whether anything but system calls is seen. Not with sanitizers, which bring their own allocator and memory.
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
