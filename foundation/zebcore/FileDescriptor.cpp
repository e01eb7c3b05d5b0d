#include "foundation/zebcore/internal/FileDescriptor.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/internal/FileSystemCalls.h"

#include <fcntl.h>

#include <cerrno>
#include <utility>

namespace zebcore::filesupport
{

namespace
{

constexpr mode_t kReadableAndWritable = 0666; // less what the user masks

template <typename Call>
auto RepeatInterrupted(Call call)
{
    auto result = call();
    while (result == -1 && errno == EINTR)
        result = call();
    return result;
}

} // namespace

FileDescriptor::FileDescriptor(const UTF16String& path, int flags, mode_t mode, std::string_view action)
    : mPath(path), mAction(action)
{
    // The system would stop at a zero unit, and open a file of another name.
    if (path.find(u'\0') != UTF16String::npos)
        throw file_exception(action, path, EINVAL);
    const std::string native = ToNativePath(path);
    mDescriptor = RepeatInterrupted([&] { return FileSystem().mOpen(native.c_str(), flags, mode); });
    if (mDescriptor < 0)
        ThrowLastError();
}

FileDescriptor FileDescriptor::Create(const UTF16String& path)
{
    return {path, O_WRONLY | O_CREAT | O_TRUNC, kReadableAndWritable, "cannot write"};
}

FileDescriptor::~FileDescriptor()
{
    if (mDescriptor >= 0)
        FileSystem().mClose(mDescriptor);
}

void FileDescriptor::Write(std::u8string_view data)
{
    while (!data.empty())
    {
        const ssize_t written =
            RepeatInterrupted([&] { return FileSystem().mWrite(mDescriptor, data.data(), data.size()); });
        if (written < 0)
            ThrowLastError();
        if (written == 0)
            throw file_exception(mAction, mPath, ENOSPC); // would go on for ever
        data.remove_prefix(static_cast<std::size_t>(written));
    }
}

void FileDescriptor::Flush()
{
    if (RepeatInterrupted([this] { return FileSystem().mFlush(mDescriptor); }) != 0)
        ThrowLastError();
}

void FileDescriptor::Close()
{
    // Not repeated: the descriptor is gone after an interrupted close, too.
    if (FileSystem().mClose(std::exchange(mDescriptor, -1)) != 0 && errno != EINTR)
        ThrowLastError();
}

void FileDescriptor::ThrowLastError() const
{
    throw file_exception(mAction, mPath, errno);
}

} // namespace zebcore::filesupport
