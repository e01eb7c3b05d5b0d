#pragma once

#include "scan/LineBuffer.h"
#include "scan/WorkerEnd.h"
#include "scan/WorkerOutput.h"

#include <optional>
#include <string>
#include <vector>

#include <sys/types.h>

namespace zebhost
{

// A worker process as its parent sees it: lines go to and fro, and what plug-ins print is taken off it, however much
// it is, so that it never blocks. It has a process group of its own: Ctrl-C does not reach it, and whatever plug-ins
// start in it ends with it. SIGPIPE has to be ignored while one lives. [main]
class ScanWorkerProcess
{
public:
    // Starts it. Throws a Failure.
    ScanWorkerProcess(const std::vector<std::string>& commandLine, WorkerOutput& output);
    // Ends it.
    ~ScanWorkerProcess();
    ScanWorkerProcess(const ScanWorkerProcess&) = delete;
    ScanWorkerProcess& operator=(const ScanWorkerProcess&) = delete;

    // A worker that has gone takes nothing, which Wait tells.
    void Send(std::string_view line) const;

    enum class Event
    {
        Line,
        Silence, // for a moment
        Ended    // no line is to come any more
    };
    // A moment is short enough for StallClock.
    Event Wait(std::string& line);

    // Ends it if it has not ended by itself, and tells how it did. Once only.
    WorkerEnd End();

private:
    void Poll() const;
    void ReadChannel();
    void ReadOutput();
    bool HasExited() const;
    bool ExitsSoon() const;

    WorkerOutput& mOutput;
    pid_t mProcess = -1;
    int mChannel = -1;
    int mPrinted = -1; // what it prints arrives here
    bool mIsConnected = true;
    LineBuffer mLines;
};

} // namespace zebhost
