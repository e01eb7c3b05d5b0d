#pragma once

#include <sys/types.h>

#include <cstddef>
#include <functional>

namespace zebcore::filesupport
{

// The system's calls through which files are written. Tests put in others that fail as a full or dying disk does.
// Results and errno as the system's own; interrupted calls are repeated by the callers.
struct FileSystemCalls
{
    FileSystemCalls();

    std::function<int(const char* path, int flags, mode_t mode)> mOpen;
    std::function<ssize_t(int descriptor, const void* data, std::size_t size)> mWrite;
    std::function<int(int descriptor)> mFlush;
    std::function<int(int descriptor)> mClose;
    std::function<int(const char* from, const char* to)> mRename;
};

// Those in force. To be changed while nothing is written only.
FileSystemCalls& FileSystem();

} // namespace zebcore::filesupport
