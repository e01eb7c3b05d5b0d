#include "foundation/zebcore/internal/FileSystemCalls.h"

#include "foundation/zebcore/internal/PlatformFiles.h"

#include <fcntl.h>
#include <unistd.h>

#include <cstdio>

namespace zebcore::filesupport
{

FileSystemCalls::FileSystemCalls()
    : mOpen([](const char* path, int flags, mode_t mode) { return open(path, flags | O_CLOEXEC, mode); })
    , mWrite([](int descriptor, const void* data, std::size_t size) { return write(descriptor, data, size); })
    , mFlush([](int descriptor) { return FlushToDisk(descriptor); })
    , mClose([](int descriptor) { return close(descriptor); })
    , mRename([](const char* from, const char* to) { return std::rename(from, to); })
{
}

FileSystemCalls& FileSystem()
{
    static FileSystemCalls sCalls;
    return sCalls;
}

} // namespace zebcore::filesupport
