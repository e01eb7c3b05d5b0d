#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/Flags.h"

#include <memory>

namespace zebcore::filesupport
{

class FileDescriptor;

/// A read-only stream of the bytes of a file. It belongs to one thread at a time. [any]
class ZEB_EXPORT IPlatformByteStream
{
public:
    static constexpr unsigned int kOpenForReading = 1;

    /// Throws file_exception if the file can't be opened, is a directory, or `flags` lacks kOpenForReading.
    IPlatformByteStream(const File& file, utility::Flags<unsigned int> flags);

    IPlatformByteStream(const IPlatformByteStream&) = delete;
    IPlatformByteStream& operator=(const IPlatformByteStream&) = delete;

    ~IPlatformByteStream();

    /// Length of the file in bytes; 0 for what has no length, such as a pipe. Throws file_exception.
    unsigned long long Length() const;

    /// Reads up to `count` bytes from the current position, and fewer only at the end of the file. Returns the number
    /// of bytes read. Throws file_exception.
    unsigned int ReadBlock(unsigned char* buffer, unsigned int count);

private:
    std::unique_ptr<FileDescriptor> mDescriptor; // never null
};

} // namespace zebcore::filesupport
