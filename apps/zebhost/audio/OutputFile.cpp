#include "audio/OutputFile.h"

#include "cli/Failure.h"
#include "cli/StartFolder.h"
#include "cli/WantOfRoom.h"
#include "filter/CrashGuard.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace zebhost
{

namespace fs = std::filesystem;

namespace
{

mode_t UsualMode()
{
    const mode_t mask = umask(0);
    umask(mask);
    return 0666 & ~mask;
}

} // namespace

OutputFile::OutputFile(const std::string& path, bool overwrite)
    : mPath(path), mTarget(startfolder::Resolve(path)), mOverwrite(overwrite)
{
    std::error_code error;
    if (fs::is_directory(mTarget, error))
    {
        throw Failure(ExitCode::FileTrouble, path + " is a folder: name a file in it, or use --out-dir");
    }
    RefuseExisting();
    mTemporary = (mTarget.parent_path() / ("." + mTarget.filename().string().substr(0, 200) + ".XXXXXX")).string();
    mDescriptor = mkstemp(mTemporary.data());
    if (mDescriptor < 0)
    {
        mTemporary.clear();
        Refuse("cannot be written");
    }
    fcntl(mDescriptor, F_SETFD, FD_CLOEXEC);
    struct stat old
    {
    };
    const bool replaces = stat(mTarget.c_str(), &old) == 0;
    fchmod(mDescriptor, replaces ? old.st_mode & 07777 : UsualMode());
    CrashGuard::RemoveOnCrash(mTemporary);
}

OutputFile::~OutputFile()
{
    if (mDescriptor >= 0)
    {
        close(mDescriptor);
    }
    if (!mTemporary.empty())
    {
        unlink(mTemporary.c_str());
        CrashGuard::RemoveOnCrash({});
    }
}

void OutputFile::Commit()
{
    if (fsync(mDescriptor) != 0)
    {
        Refuse("could not be written to the end");
    }
    RefuseExisting();
    Rename();
    CrashGuard::RemoveOnCrash({});
    mTemporary.clear();
}

void OutputFile::RefuseExisting() const
{
    std::error_code error;
    if (!mOverwrite && fs::exists(fs::symlink_status(mTarget, error)))
    {
        throw Failure(ExitCode::FileTrouble, mPath + " exists: give --overwrite to replace it, or another name");
    }
}

void OutputFile::Rename() const
{
    if (std::rename(mTemporary.c_str(), mTarget.c_str()) != 0)
    {
        Refuse("could not be given its name");
    }
}

void OutputFile::Refuse(const std::string& action) const
{
    throw Failure(ExitCode::FileTrouble,
                  mPath + " " + action + " (" + std::strerror(errno) + "): " +
                      (IsWantOfRoom(errno) ? "make room on the disk" : "choose a folder that can be written to"));
}

} // namespace zebhost
