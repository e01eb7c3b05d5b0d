#pragma once

#include <string>
#include <vector>

#include <sys/types.h>

namespace zebhost
{

struct SpawnedWorker
{
    pid_t process;
    int channel; // the caller's end of the socket that the worker has as kWorkerChannel
    int printed; // not blocking: what it writes to its standard output and error
};

// Starts this program again, in a process group of its own. Throws a Failure.
SpawnedWorker SpawnWorker(const std::vector<std::string>& commandLine);

} // namespace zebhost
