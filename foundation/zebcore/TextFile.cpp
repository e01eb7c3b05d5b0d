#include "foundation/zebcore/internal/TextFile.h"

#include "foundation/zebcore/FileExceptions.h"

#include <cerrno>

namespace zebcore::filesupport
{

namespace
{

constexpr unsigned long long kMaxSize = 1ULL << 31U;

} // namespace

TextFile::TextFile(const UTF16String& path)
    : mPath(path)
    , mStream(File(path), utility::Flags<unsigned int>(IPlatformByteStream::kOpenForReading))
    , mLength(mStream.Length())
{
    Check(mLength);
}

unsigned int TextFile::ReadBlock(unsigned char* buffer, unsigned int count)
{
    Check(mDone);
    const unsigned int read = mStream.ReadBlock(buffer, count);
    mDone += read;
    return read;
}

void TextFile::Check(unsigned long long size) const
{
    if (size > kMaxSize)
        throw file_exception("cannot read", mPath, EFBIG);
}

} // namespace zebcore::filesupport
