#include "audio/OutputStream.h"

#include <cerrno>

#include <sys/stat.h>
#include <unistd.h>

namespace zebhost
{

SoundFile OutputStream::Open(SF_INFO& info)
{
    SF_VIRTUAL_IO access = {Length, Seek, Read, Write, Tell};
    return SoundFile(sf_open_virtual(&access, SFM_WRITE, &info, this));
}

sf_count_t OutputStream::Length(void* user)
{
    struct stat status
    {
    };
    return fstat(static_cast<OutputStream*>(user)->mDescriptor, &status) == 0 ? status.st_size : -1;
}

sf_count_t OutputStream::Seek(sf_count_t offset, int origin, void* user)
{
    return lseek(static_cast<OutputStream*>(user)->mDescriptor, offset, origin);
}

sf_count_t OutputStream::Read(void* target, sf_count_t count, void* user)
{
    return read(static_cast<OutputStream*>(user)->mDescriptor, target, static_cast<std::size_t>(count));
}

sf_count_t OutputStream::Write(const void* source, sf_count_t count, void* user)
{
    auto& stream = *static_cast<OutputStream*>(user);
    sf_count_t written = 0;
    while (written < count)
    {
        const ssize_t step = write(stream.mDescriptor, static_cast<const char*>(source) + written,
                                   static_cast<std::size_t>(count - written));
        if (step < 0 && errno == EINTR)
        {
            continue;
        }
        if (step <= 0)
        {
            const int error = step < 0 ? errno : ENOSPC;
            stream.mError = stream.mError != 0 ? stream.mError : error;
            return written;
        }
        written += step;
    }
    return written;
}

sf_count_t OutputStream::Tell(void* user)
{
    return Seek(0, SEEK_CUR, user);
}

} // namespace zebhost
