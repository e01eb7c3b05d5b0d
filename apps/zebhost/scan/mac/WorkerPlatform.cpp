#include "scan/WorkerPlatform.h"

#include <cerrno>
#include <chrono>
#include <csignal>
#include <cstdint>
#include <thread>

#include <mach-o/dyld.h>
#include <sys/event.h>
#include <unistd.h>

namespace zebhost::platform
{

std::string OwnProgram()
{
    std::uint32_t size = 0;
    _NSGetExecutablePath(nullptr, &size);
    std::string path(size, '\0');
    _NSGetExecutablePath(path.data(), &size);
    path.resize(path.find('\0'));
    return path;
}

bool DieWith(pid_t parent)
{
    const int queue = kqueue();
    struct kevent watch
    {
    };
    EV_SET(&watch, static_cast<uintptr_t>(parent), EVFILT_PROC, EV_ADD, NOTE_EXIT, 0, nullptr);
    if (queue < 0 || kevent(queue, &watch, 1, nullptr, 0, nullptr) != 0)
    {
        return false;
    }
    std::thread(
        [queue, parent]
        {
            constexpr std::chrono::milliseconds kAgain(100);
            struct kevent event
            {
            };
            // A plug-in may have closed the queue. The parent's end is then seen by the new parent alone.
            while (kevent(queue, nullptr, 0, &event, 1, nullptr) < 1 && getppid() == parent)
            {
                if (errno != EINTR)
                {
                    std::this_thread::sleep_for(kAgain);
                }
            }
            kill(getpid(), SIGKILL);
        })
        .detach();
    return getppid() == parent;
}

// The limit on the size of core files is enough.
void ForbidDumps()
{
}

} // namespace zebhost::platform
