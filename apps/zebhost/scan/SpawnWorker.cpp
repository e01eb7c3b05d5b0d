#include "scan/SpawnWorker.h"

#include "cli/Failure.h"
#include "scan/ScanWorker.h"
#include "scan/WorkerPlatform.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>

#include <fcntl.h>
#include <spawn.h>
#include <sys/socket.h>
#include <unistd.h>

extern "C" char** environ; // which not every system's headers declare

namespace zebhost
{

namespace
{

[[noreturn]] void Refuse(int error)
{
    throw Failure(ExitCode::JobFailed, std::string("the scan's worker process could not be started: ") +
                                           std::strerror(error) + "; end other programs, or scan with --in-process");
}

// Two descriptors that no other program inherits. The second is to become the child's, and lies above all those that
// it is to have, so that none of them is overwritten before it is copied.
struct Ends
{
    int ours = -1;
    int theirs = -1;

    explicit Ends(std::array<int, 2> pair)
    {
        constexpr int kAboveAll = 16;
        ours = fcntl(pair[0], F_DUPFD_CLOEXEC, kAboveAll);
        theirs = fcntl(pair[1], F_DUPFD_CLOEXEC, kAboveAll);
        close(pair[0]);
        close(pair[1]);
        if (ours < 0 || theirs < 0)
        {
            Refuse(EMFILE);
        }
    }
};

Ends MakeChannel()
{
    std::array<int, 2> pair{};
    if (socketpair(AF_UNIX, SOCK_STREAM, 0, pair.data()) != 0)
    {
        Refuse(errno);
    }
    return Ends(pair);
}

Ends MakePipe()
{
    std::array<int, 2> pair{};
    if (pipe(pair.data()) != 0)
    {
        Refuse(errno);
    }
    const Ends ends(pair);
    fcntl(ends.ours, F_SETFL, O_NONBLOCK);
    return ends;
}

// Signals as a fresh program has them, though this one ignores some.
void SetAttributes(posix_spawnattr_t& attributes)
{
    sigset_t signals;
    sigemptyset(&signals);
    posix_spawnattr_setsigmask(&attributes, &signals);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGPIPE, SIGCHLD})
    {
        sigaddset(&signals, signal);
    }
    posix_spawnattr_setsigdefault(&attributes, &signals);
    posix_spawnattr_setpgroup(&attributes, 0);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETPGROUP | POSIX_SPAWN_SETSIGDEF | POSIX_SPAWN_SETSIGMASK);
}

void SetDescriptors(posix_spawn_file_actions_t& actions, int channel, int printed)
{
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_adddup2(&actions, printed, STDOUT_FILENO);
    posix_spawn_file_actions_adddup2(&actions, printed, STDERR_FILENO);
    posix_spawn_file_actions_adddup2(&actions, channel, kWorkerChannel);
}

int Spawn(pid_t& process, std::vector<std::string> words, int channel, int printed)
{
    std::vector<char*> pointers;
    for (std::string& word : words)
    {
        pointers.push_back(word.data());
    }
    pointers.push_back(nullptr);
    posix_spawnattr_t attributes{};
    posix_spawn_file_actions_t actions{};
    posix_spawnattr_init(&attributes);
    posix_spawn_file_actions_init(&actions);
    SetAttributes(attributes);
    SetDescriptors(actions, channel, printed);
    const int error =
        posix_spawn(&process, platform::OwnProgram().c_str(), &actions, &attributes, pointers.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    posix_spawnattr_destroy(&attributes);
    return error;
}

} // namespace

SpawnedWorker SpawnWorker(const std::vector<std::string>& commandLine)
{
    const Ends channel = MakeChannel();
    const Ends printed = MakePipe();
    pid_t process = -1;
    const int error = Spawn(process, commandLine, channel.theirs, printed.theirs);
    close(channel.theirs);
    close(printed.theirs);
    if (error != 0)
    {
        close(channel.ours);
        close(printed.ours);
        Refuse(error);
    }
    return {process, channel.ours, printed.ours};
}

} // namespace zebhost
