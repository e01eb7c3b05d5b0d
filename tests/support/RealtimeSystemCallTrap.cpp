// The net for system calls: the kernel hands those of a section over as signals.
#include "tests/support/RealtimeGuardInternal.h"

#if ZEB_GUARD_INTERPOSES

#include <csignal>
#include <sys/prctl.h>
#include <ucontext.h>

namespace realtimeguard
{

namespace
{

// Of linux/prctl.h, which may be older than the kernel.
constexpr int kSetSyscallUserDispatch = 59;
constexpr unsigned long kDispatchOn = 1;
constexpr unsigned char kAllow = 0;
constexpr unsigned char kBlock = 1;
constexpr int kSystemCallInstructionLength = 2;

enum class Trap
{
    Unknown,
    Installed,
    Unavailable
};

constinit thread_local volatile unsigned char sSelector = kAllow; // Read by the kernel at each call of the thread
constinit thread_local Trap sTrap = Trap::Unknown;

// Lets the call through by running its instruction again. The net stays open until the next section, so that nothing
// has to be emulated.
void OnSystemCall(int, siginfo_t* info, void* context)
{
    sSelector = kAllow;
    Record(Violation::SystemCall);
    auto& registers = static_cast<ucontext_t*>(context)->uc_mcontext.gregs;
    registers[REG_RIP] -= kSystemCallInstructionLength;
    registers[REG_RAX] = info->si_syscall;
}

bool InstallHandler()
{
    struct sigaction action = {};
    action.sa_sigaction = OnSystemCall;
    action.sa_flags = SA_SIGINFO;
    return sigaction(SIGSYS, &action, nullptr) == 0;
}

Trap InstallTrap()
{
    static const bool sHandlerInstalled = InstallHandler();
    const bool dispatched =
        sHandlerInstalled && prctl(kSetSyscallUserDispatch, kDispatchOn, 0UL, 0UL, &sSelector) == 0;
    return dispatched ? Trap::Installed : Trap::Unavailable;
}

} // namespace

bool CatchesSystemCalls()
{
    if (sTrap == Trap::Unknown)
        sTrap = InstallTrap();
    return sTrap == Trap::Installed;
}

void ArmSystemCallTrap() noexcept
{
    if (CatchesSystemCalls())
        sSelector = kBlock;
}

void DisarmSystemCallTrap() noexcept
{
    sSelector = kAllow;
}

} // namespace realtimeguard

#else

namespace realtimeguard
{

bool CatchesSystemCalls()
{
    return false;
}

void ArmSystemCallTrap() noexcept
{
}

void DisarmSystemCallTrap() noexcept
{
}

} // namespace realtimeguard

#endif
