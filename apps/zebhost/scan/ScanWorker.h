#pragma once

#include "scan/ScanWorkerProtocol.h"

#include <string>
#include <vector>

#include <sys/types.h>

namespace zebhost
{

// The side of the scan that touches plug-ins: this program again, in a process of its own. It reads no catalogue and
// writes no file: what it finds goes to the process that started it, and with that it ends.

// What the worker is to know, as words of its command line.
struct WorkerSetup
{
    std::string settings; // the folder
    bool skipCategory = false;
    std::vector<std::string> traces;
};

// The descriptor on which both talk, to begin with: the worker moves it out of its plug-ins' way.
inline constexpr int kWorkerChannel = 3;

std::vector<std::string> WorkerCommandLine(const WorkerSetup& setup, pid_t parent);

// Whether the command line is one of the above. It is no command of the user's.
bool IsWorkerCommandLine(int argc, const char* const* argv);

// Does not return.
[[noreturn]] void RunScanWorker(int argc, const char* const* argv);

} // namespace zebhost
