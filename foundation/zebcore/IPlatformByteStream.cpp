#include "foundation/zebcore/IPlatformByteStream.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/internal/FileDescriptor.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>

namespace zebcore::filesupport
{

namespace
{

constexpr const char* kCannotRead = "cannot read";

struct stat Status(const FileDescriptor& descriptor)
{
    struct stat status = {};
    if (fstat(descriptor.Get(), &status) != 0)
        descriptor.ThrowLastError();
    return status;
}

} // namespace

IPlatformByteStream::IPlatformByteStream(const File& file, utility::Flags<unsigned int> flags)
{
    if (!flags.IsSet(kOpenForReading))
        throw file_exception(kCannotRead, file.FullPath(), EINVAL);
    mDescriptor = std::make_unique<FileDescriptor>(file.FullPath(), O_RDONLY, 0, kCannotRead);
    if (S_ISDIR(Status(*mDescriptor).st_mode))
        throw file_exception(kCannotRead, file.FullPath(), EISDIR);
}

IPlatformByteStream::~IPlatformByteStream() = default;

unsigned long long IPlatformByteStream::Length() const
{
    const struct stat status = Status(*mDescriptor);
    return S_ISREG(status.st_mode) ? static_cast<unsigned long long>(status.st_size) : 0;
}

unsigned int IPlatformByteStream::ReadBlock(unsigned char* buffer, unsigned int count)
{
    unsigned int done = 0;
    while (done < count)
    {
        const ssize_t got = read(mDescriptor->Get(), buffer + done, count - done);
        if (got == 0)
            break;
        if (got > 0)
            done += static_cast<unsigned int>(got);
        else if (errno != EINTR)
            mDescriptor->ThrowLastError();
    }
    return done;
}

} // namespace zebcore::filesupport
