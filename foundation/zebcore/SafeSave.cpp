#include "foundation/zebcore/SafeSave.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/internal/FileDescriptor.h"
#include "foundation/zebcore/internal/FileStatus.h"
#include "foundation/zebcore/internal/FileSystemCalls.h"
#include "foundation/zebcore/internal/Paths.h"
#include "foundation/zebcore/internal/TempFiles.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <string>
#include <vector>

namespace zebcore::filesupport
{

namespace
{

constexpr const char* kCannotSave = "cannot save";
constexpr int kMaxLinks = 40; // as many as the system follows
constexpr mode_t kAllModeBits = 07777;
constexpr mode_t kPermissionBits = 0777; // without those that act in the owner's name

// Where the link leads; an empty path if the file is missing or no link.
UTF16String ReadLink(const UTF16String& path)
{
    std::vector<char> buffer(4096);
    const ssize_t length = readlink(ToNativePath(path).c_str(), buffer.data(), buffer.size());
    if (length < 0 && errno != EINVAL && errno != ENOENT)
        throw file_exception(kCannotSave, path, errno);
    return length <= 0 ? UTF16String() : FromNativePath({buffer.data(), static_cast<std::size_t>(length)});
}

File ResolveLinks(const File& target)
{
    UTF16String path = target.FullPath();
    if (path.empty() || path.find(u'\0') != UTF16String::npos)
        throw file_exception(kCannotSave, path, EINVAL);
    for (int i = 0; i < kMaxLinks; ++i)
    {
        const UTF16String link = ReadLink(path);
        if (link.empty())
            return File(path);
        path = link.front() == u'/' ? link : Join(ParentOf(path), link);
    }
    throw file_exception(kCannotSave, target.FullPath(), ELOOP);
}

bool IsThere(const File& target)
{
    const FileStatus status = GetFileStatus(target.FullPath());
    if (status.mError == 0 && !S_ISREG(status.mStat.st_mode))
        throw file_exception(kCannotSave, target.FullPath(), "It is not a regular file");
    return status.mError == 0;
}

// As far as the user may and the file system knows such things.
void TakeOnOwnerAndPermissions(int descriptor, const File& old)
{
    const FileStatus status = GetFileStatus(old.FullPath());
    if (status.mError != 0)
        return;
    const bool isOwned = fchown(descriptor, status.mStat.st_uid, status.mStat.st_gid) == 0;
    fchmod(descriptor, status.mStat.st_mode & (isOwned ? kAllModeBits : kPermissionBits));
}

bool IsRefusal(int error)
{
    return error == EPERM || error == EACCES || error == EBUSY;
}

// File systems that can't flush a folder say so in one of these ways.
bool MeansUnsupported(int error)
{
    return error == EINVAL || error == ENOTSUP || error == ENOSYS || error == EBADF;
}

} // namespace

SafeSave::SafeSave(File& target) : mTarget(ResolveLinks(target)), mReplaces(IsThere(mTarget)), mTemp(target)
{
    RemoveAbandonedTempFiles(mTarget);
    mTemp = MakeTempFile(mTarget, mReplaces);
}

SafeSave::~SafeSave()
{
    if (!mDone)
        Discard();
}

void SafeSave::Commit()
{
    if (mDone)
        return;
    try
    {
        Flush();
        Replace();
    }
    catch (...)
    {
        Discard();
        throw;
    }
    mDone = true;
    FlushFolder();
}

void SafeSave::Flush() const
{
    try
    {
        FileDescriptor temp(mTemp.FullPath(), O_RDONLY, 0, kCannotSave);
        // Only now: the permissions of the old file may forbid writing.
        TakeOnOwnerAndPermissions(temp.Get(), mTarget);
        temp.Flush();
        temp.Close();
    }
    catch (const file_exception& failure)
    {
        throw file_exception(kCannotSave, mTarget.FullPath(), failure.Error());
    }
}

void SafeSave::Replace()
{
    const std::string from = ToNativePath(mTemp.FullPath());
    const std::string to = ToNativePath(mTarget.FullPath());
    if (FileSystem().mRename(from.c_str(), to.c_str()) == 0)
        return;
    const int error = errno;
    if (mReplaces && IsRefusal(error))
        throw file_delete_exception("cannot replace", mTarget.FullPath(), error);
    throw file_exception(kCannotSave, mTarget.FullPath(), error);
}

void SafeSave::FlushFolder() const
{
    const UTF16String folder = mTarget.GetDir().FullPath();
    try
    {
        FileDescriptor(folder.empty() ? u"." : folder, O_RDONLY, 0, "cannot flush").Flush();
    }
    catch (const file_exception& failure)
    {
        // A folder that may be written and not read can't be flushed either.
        if (failure.Error() != EACCES && !MeansUnsupported(failure.Error()))
            throw file_exception("saved, but perhaps not for good,", mTarget.FullPath(), failure.Error());
    }
}

void SafeSave::Discard() noexcept
{
    try
    {
        unlink(ToNativePath(mTemp.FullPath()).c_str());
    }
    catch (const std::bad_alloc&)
    {
        // It stays; a later save of the file removes it.
    }
}

} // namespace zebcore::filesupport
