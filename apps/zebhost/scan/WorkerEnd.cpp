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

constexpr std::array<SignalText, 15> kSignals = {{
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
    {SIGQUIT, "SIGQUIT (asked to end)"},
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
    return kind == Kind::Signalled && (value == SIGINT || value == SIGTERM || value == SIGHUP || value == SIGQUIT);
}

std::string WorkerEnd::Describe() const
{
    switch (kind)
    {
    case Kind::Exited:
        if (value != kChannelLost)
        {
            return "ended the process with exit status " + std::to_string(value);
        }
        break;
    case Kind::Signalled:
        return (IsByUser() ? "was ended from outside: " : "crashed: ") + SignalName(value);
    case Kind::Disconnected:
        break;
    }
    return "disturbed the connection between the scan and its worker process";
}

} // namespace zebhost
