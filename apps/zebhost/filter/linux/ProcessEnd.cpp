#include "filter/CrashGuard.h"

#include <sys/syscall.h>
#include <unistd.h>

// A plug-in that calls one of these would end the process as if all were done. The program's own come before those of
// the C library, for all that is loaded into it.

// NOLINTBEGIN(bugprone-reserved-identifier,cert-dcl37-c,cert-dcl51-cpp,readability-identifier-naming): given names
extern "C" [[gnu::visibility("default")]] void _exit(int status)
{
    zebhost::CrashGuard::NoteEnd();
    while (true)
    {
        syscall(SYS_exit_group, status);
    }
}

extern "C" [[gnu::visibility("default")]] void _Exit(int status) noexcept
{
    _exit(status);
}
// NOLINTEND(bugprone-reserved-identifier,cert-dcl37-c,cert-dcl51-cpp,readability-identifier-naming)
