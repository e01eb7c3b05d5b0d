#pragma once

#include <string>

#include <sys/types.h>

// What a worker process needs of the system beyond POSIX.
namespace zebhost::platform
{

// This program, however it was called and whatever has become of its file.
std::string OwnProgram();

// From now on the calling process ends at once when `parent` does. Returns false if that has gone already.
bool DieWith(pid_t parent);

// Crashes of the calling process are written nowhere, not even to a program that the system hands them to.
void ForbidDumps();

} // namespace zebhost::platform
