#include "scan/WorkerPlatform.h"

#include <csignal>

#include <sys/prctl.h>
#include <unistd.h>

namespace zebhost::platform
{

std::string OwnProgram()
{
    return "/proc/self/exe";
}

bool DieWith(pid_t parent)
{
    prctl(PR_SET_PDEATHSIG, SIGKILL);
    // It may have died before.
    return getppid() == parent;
}

// The limit on the size of core files does not hold for a core pattern that is a pipe.
void ForbidDumps()
{
    prctl(PR_SET_DUMPABLE, 0);
}

} // namespace zebhost::platform
