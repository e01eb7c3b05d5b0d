#include "scan/ScanWorker.h"

#include "catalogue/SettingsFolder.h"
#include "output/Tracing.h"
#include "scan/LineBuffer.h"
#include "scan/PluginScan.h"
#include "scan/WorkerEnd.h"
#include "scan/WorkerPlatform.h"

#include <foundation/zebcore/PropList.h>
#include <foundation/zebcore/PropListUtils.h>
#include <host/BannedPluginManager.h>
#include <host/PluginModuleInfoManager.h>
#include <module/Module.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <charconv>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <string_view>

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <unistd.h>

namespace zebhost
{

using zebaudiofilterhost::BannedPluginManager;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;

namespace
{

constexpr std::string_view kWord = "--scan-worker";
// Words in front of the categories to trace.
constexpr int kFixedWords = 5;

// Behind the numbers that plug-ins close in a row, and below the smallest usual limit.
constexpr int kHighDescriptor = 200;
int sChannel = kWorkerChannel;

pid_t ParsePid(std::string_view text)
{
    pid_t pid = -1;
    std::from_chars(text.data(), text.data() + text.size(), pid);
    return pid;
}

// Nobody is left to work for, or to tell.
[[noreturn]] void End(int status)
{
    _exit(status);
}

// A parent that has gone is no reason for a signal. Where there is no such flag there is one.
#ifdef MSG_NOSIGNAL
constexpr int kSendFlags = MSG_NOSIGNAL;
#else
constexpr int kSendFlags = 0;
#endif

// Not write and read: a plug-in that closes what it did not open may have a file of its own there, which is no
// socket.
void Send(std::string_view line)
{
    while (!line.empty())
    {
        const ssize_t sent = send(sChannel, line.data(), line.size(), kSendFlags);
        if (sent < 0 && errno != EINTR)
        {
            End(kChannelLost);
        }
        line.remove_prefix(static_cast<std::size_t>(std::max<ssize_t>(sent, 0)));
    }
}

std::string ReceiveLine(LineBuffer& lines)
{
    std::array<char, 4096> piece{};
    while (true)
    {
        if (auto line = lines.Next())
        {
            return *std::move(line);
        }
        const ssize_t size = recv(sChannel, piece.data(), piece.size(), 0);
        if (size == 0 || (size < 0 && errno != EINTR))
        {
            End(EXIT_SUCCESS);
        }
        lines.Append({piece.data(), static_cast<std::size_t>(std::max<ssize_t>(size, 0))});
    }
}

void MoveChannel()
{
    const int moved = fcntl(kWorkerChannel, F_DUPFD_CLOEXEC, kHighDescriptor);
    if (moved < 0)
    {
        fcntl(kWorkerChannel, F_SETFD, FD_CLOEXEC);
        return;
    }
    close(kWorkerChannel);
    sChannel = moved;
}

// The scan is to see each plug-in's true end, and a plug-in's children are not to keep the channel open.
void SetUpProcess()
{
    MoveChannel();
    platform::ForbidDumps();
    // Last words are worth most, and would stay in the buffer.
    std::setvbuf(stdout, nullptr, _IOLBF, BUFSIZ);
    for (const int signal : {SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGABRT, SIGTRAP})
    {
        std::signal(signal, SIG_DFL);
    }
    // Memory of a process full of plug-ins makes large files, and a scan may crash many times.
    const rlimit none{0, 0};
    setrlimit(RLIMIT_CORE, &none);
}

void SetUpLibrary(const std::string& settings, const std::vector<std::string>& traces)
{
    StartTracing(traces);
    zebaudiofilterhost::Initialize();
    const SettingsFolder folder(settings);
    zebcore::filesupport::File permanent = ToFile(folder.PermanentBlocks());
    BannedPluginManager::GetInstance().LoadStaticConfiguration(permanent);
}

void Scan(const PluginLocator& locator, bool skipCategory)
{
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    const IScanObserver::Outcome outcome =
        ScanPlugin(locator, skipCategory, [](const std::string& detail) { Send(protocol::StepLine(detail)); });
    zebcore::proplist::PropList list;
    infos.BuildConfigurationPropList(list, false);
    zebcore::UTF8String found;
    zebcore::proplist::utils::WritePropList(found, list);
    infos.ClearAll(true);
    Send(protocol::ResultLine(outcome, found));
}

void Serve(bool skipCategory)
{
    Send(protocol::ReadyLine());
    LineBuffer lines;
    while (true)
    {
        const std::optional<PluginLocator> locator = protocol::ParseScan(ReceiveLine(lines));
        if (!locator)
        {
            End(EXIT_FAILURE);
        }
        Scan(*locator, skipCategory);
    }
}

} // namespace

std::vector<std::string> WorkerCommandLine(const WorkerSetup& setup, pid_t parent)
{
    std::vector<std::string> words = {"zebhost", std::string(kWord), std::to_string(parent), setup.settings,
                                      setup.skipCategory ? "skip-category" : "all"};
    words.insert(words.end(), setup.traces.begin(), setup.traces.end());
    return words;
}

bool IsWorkerCommandLine(int argc, const char* const* argv)
{
    return argc >= kFixedWords && argv[1] == kWord;
}

void RunScanWorker(int argc, const char* const* argv)
{
    if (!platform::DieWith(ParsePid(argv[2])))
    {
        End(EXIT_FAILURE);
    }
    try
    {
        SetUpProcess();
        SetUpLibrary(argv[3], {argv + kFixedWords, argv + argc});
        Serve(argv[4] == std::string_view("skip-category"));
    }
    catch (...)
    {
        std::fputs("the worker process has failed\n", stderr);
    }
    End(EXIT_FAILURE);
}

} // namespace zebhost
