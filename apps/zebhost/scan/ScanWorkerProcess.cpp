#include "scan/ScanWorkerProcess.h"

#include "scan/SpawnWorker.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <thread>

#include <poll.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

namespace zebhost
{

namespace
{

constexpr int kMomentMilliseconds = 50;
constexpr std::size_t kPieceSize = 65536;
// A plug-in that prints more than this is slowed down: it must not keep this process busy.
constexpr std::size_t kMuchOutput = 1 << 20;
constexpr int kSlowMilliseconds = 5;
// A message of more than this is none of ours.
constexpr std::size_t kLongestMessage = 256 << 20;

} // namespace

ScanWorkerProcess::ScanWorkerProcess(const std::vector<std::string>& commandLine, WorkerOutput& output)
    : mOutput(output)
{
    const SpawnedWorker spawned = SpawnWorker(commandLine);
    mProcess = spawned.process;
    mChannel = spawned.channel;
    mPrinted = spawned.printed;
}

ScanWorkerProcess::~ScanWorkerProcess()
{
    if (mProcess > 0)
    {
        End();
    }
    close(mChannel);
    close(mPrinted);
}

void ScanWorkerProcess::Send(std::string_view line) const
{
    while (!line.empty())
    {
        const ssize_t sent = write(mChannel, line.data(), line.size());
        if (sent < 0 && errno != EINTR)
        {
            return;
        }
        line.remove_prefix(static_cast<std::size_t>(std::max<ssize_t>(sent, 0)));
    }
}

ScanWorkerProcess::Event ScanWorkerProcess::Wait(std::string& line)
{
    std::optional<std::string> next = mLines.Next();
    if (!next)
    {
        Poll();
        // In this order: what it sent before its end is read in any case.
        const bool hasExited = HasExited();
        ReadOutput();
        ReadChannel();
        next = mLines.Next();
        if (!next)
        {
            return hasExited || !mIsConnected ? Event::Ended : Event::Silence;
        }
    }
    line = *std::move(next);
    return Event::Line;
}

void ScanWorkerProcess::Poll() const
{
    const bool isSlowed = mOutput.Amount() > kMuchOutput;
    std::array<pollfd, 2> watched = {pollfd{mChannel, POLLIN, 0}, pollfd{mPrinted, POLLIN, 0}};
    poll(watched.data(), isSlowed ? 1 : 2, isSlowed ? kSlowMilliseconds : kMomentMilliseconds);
}

// All that is there, since its last words may lie behind a lot.
void ScanWorkerProcess::ReadChannel()
{
    std::array<char, kPieceSize> piece{};
    while (mIsConnected)
    {
        const ssize_t size = recv(mChannel, piece.data(), piece.size(), MSG_DONTWAIT);
        if (size < 0)
        {
            mIsConnected = errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR;
            return;
        }
        mLines.Append({piece.data(), static_cast<std::size_t>(size)});
        mIsConnected = size > 0 && mLines.Size() <= kLongestMessage;
    }
}

// Some at a time, since an endless writer never leaves nothing.
void ScanWorkerProcess::ReadOutput()
{
    constexpr int kPieces = 4;
    std::array<char, kPieceSize> piece{};
    for (int count = 0; count < kPieces; ++count)
    {
        const ssize_t size = read(mPrinted, piece.data(), piece.size());
        if (size <= 0)
        {
            return;
        }
        mOutput.Take({piece.data(), static_cast<std::size_t>(size)});
    }
}

bool ScanWorkerProcess::HasExited() const
{
    siginfo_t info{};
    // Not reaped yet, so that its number stays its own.
    return waitid(P_PID, static_cast<id_t>(mProcess), &info, WEXITED | WNOHANG | WNOWAIT) == 0 &&
           info.si_pid == mProcess;
}

// A process closes its descriptors a while before it has ended.
bool ScanWorkerProcess::ExitsSoon() const
{
    constexpr int kTries = 400;
    constexpr std::chrono::milliseconds kPause{5};
    for (int count = 0; count < kTries; ++count)
    {
        if (HasExited())
        {
            return true;
        }
        std::this_thread::sleep_for(kPause);
    }
    return false;
}

WorkerEnd ScanWorkerProcess::End()
{
    const bool byItself = HasExited() || (!mIsConnected && mLines.Size() <= kLongestMessage && ExitsSoon());
    ReadOutput();
    kill(-mProcess, SIGKILL);
    // A plug-in may have moved the process out of its group.
    kill(mProcess, SIGKILL);
    // One that even this can't end hangs in the system; it is left behind.
    const bool hasEnded = ExitsSoon();
    int status = 0;
    if (hasEnded)
    {
        waitpid(mProcess, &status, 0);
    }
    mProcess = -1;
    if (!byItself || !hasEnded)
    {
        return {WorkerEnd::Kind::Disconnected, 0};
    }
    return WIFSIGNALED(status) ? WorkerEnd{WorkerEnd::Kind::Signalled, WTERMSIG(status)}
                               : WorkerEnd{WorkerEnd::Kind::Exited, WEXITSTATUS(status)};
}

} // namespace zebhost
