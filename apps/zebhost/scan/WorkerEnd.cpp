#include "scan/WorkerEnd.h"

#include <algorithm>
#include <array>
#include <csignal>

namespace zebhost
{

namespace
{

struct SignalText
{
    int signal;
    const char* text;
};

constexpr std::array<SignalText, 14> kSignals = {{
    {SIGSEGV, "SIGSEGV (segmentation fault)"},
    {SIGABRT, "SIGABRT (aborted)"},
    {SIGBUS, "SIGBUS (bus error)"},
    {SIGFPE, "SIGFPE (arithmetic error)"},
    {SIGILL, "SIGILL (illegal instruction)"},
    {SIGTRAP, "SIGTRAP (breakpoint)"},
    {SIGSYS, "SIGSYS (bad system call)"},
    {SIGPIPE, "SIGPIPE (broken pipe)"},
    {SIGKILL, "SIGKILL (killed, perhaps by the system for want of memory)"},
    {SIGXCPU, "SIGXCPU (processor time exceeded)"},
    {SIGXFSZ, "SIGXFSZ (file too large)"},
    {SIGTERM, "SIGTERM (asked to end)"},
    {SIGINT, "SIGINT (interrupted)"},
    {SIGHUP, "SIGHUP (hung up)"},
}};

std::string SignalName(int signal)
{
    const auto* const found = std::find_if(kSignals.begin(), kSignals.end(),
                                           [signal](const SignalText& each) { return each.signal == signal; });
    return found == kSignals.end() ? "signal " + std::to_string(signal) : found->text;
}

} // namespace

bool WorkerEnd::IsByUser() const
{
    return kind == Kind::Signalled && (value == SIGINT || value == SIGTERM || value == SIGHUP);
}

std::string WorkerEnd::Describe() const
{
    switch (kind)
    {
    case Kind::Exited:
        return "ended the process with exit status " + std::to_string(value);
    case Kind::Signalled:
        return "crashed: " + SignalName(value);
    case Kind::Disconnected:
        break;
    }
    return "disturbed the connection between the scan and its worker process";
}

} // namespace zebhost
