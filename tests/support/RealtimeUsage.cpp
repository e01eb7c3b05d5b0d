// The net for page faults and voluntary switches: the kernel's own account of the thread.
#include "tests/support/RealtimeGuardInternal.h"

#if ZEB_GUARD_INTERPOSES

#include <cstddef>
#include <cstdint>
#include <elf.h>
#include <link.h>
#include <sys/prctl.h>
#include <sys/resource.h>

namespace realtimeguard
{

namespace
{

constexpr std::size_t kPage = 4096;
constexpr std::size_t kStack = 64 * kPage; // More than a filter and its plug-in need for a block

rusage AskKernel()
{
    rusage usage = {};
    getrusage(RUSAGE_THREAD, &usage);
    return usage;
}

long FaultsOf(const rusage& usage)
{
    return usage.ru_minflt + usage.ru_majflt;
}

// Code and constants alone: the first write into a page of data stays one that is seen.
int ReadModule(dl_phdr_info* info, std::size_t, void*)
{
    for (int i = 0; i < info->dlpi_phnum; ++i)
    {
        const ElfW(Phdr)& segment = info->dlpi_phdr[i];
        if (segment.p_type != PT_LOAD || (segment.p_flags & PF_R) == 0 || (segment.p_flags & PF_W) != 0)
            continue;
        const auto* const first = reinterpret_cast<const volatile std::byte*>(info->dlpi_addr + segment.p_vaddr);
        for (std::size_t offset = 0; offset < segment.p_memsz; offset += kPage)
            static_cast<void>(first[offset]);
    }
    return 0;
}

} // namespace

UsageSection::UsageSection()
{
    const rusage usage = AskKernel();
    mFaults = FaultsOf(usage);
    mSwitches = usage.ru_nvcsw;
}

UsageSection::~UsageSection()
{
    const rusage usage = AskKernel();
    RecordUsage(Violation::PageFault, FaultsOf(usage) - mFaults);
    RecordUsage(Violation::VoluntarySwitch, usage.ru_nvcsw - mSwitches);
}

void PrepareProcess()
{
    prctl(PR_SET_THP_DISABLE, 1UL, 0UL, 0UL, 0UL);
    dl_iterate_phdr(ReadModule, nullptr);
}

void PrepareThread()
{
    [[maybe_unused]] volatile std::byte stack[kStack];
    for (std::size_t offset = 0; offset < kStack; offset += kPage)
        stack[offset] = std::byte{1};
    CatchesSystemCalls();
    AskKernel();
}

} // namespace realtimeguard

#else

namespace realtimeguard
{

UsageSection::UsageSection() : mFaults(0), mSwitches(0)
{
}

UsageSection::~UsageSection() = default;

void PrepareProcess()
{
}

void PrepareThread()
{
}

} // namespace realtimeguard

#endif
