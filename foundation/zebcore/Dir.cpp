#include "foundation/zebcore/Dir.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/internal/FileStatus.h"
#include "foundation/zebcore/internal/Paths.h"
#include "foundation/zebcore/internal/PlatformFiles.h"

#include <sys/stat.h>

#include <cerrno>

namespace zebcore::filesupport
{

namespace
{

constexpr mode_t kForUserAlone = 0700;

Dir& PrefDirOverride()
{
    static Dir sDir;
    return sDir;
}

} // namespace

Dir::Dir() = default;
Dir::Dir(const UTF16String& path) : mPath(WithoutTrailingSlashes(path))
{
}
Dir::Dir(const Dir& other) = default;
Dir::Dir(const Dir& parent, const UTF16String& subPath) : mPath(Join(parent.mPath, subPath))
{
}
Dir& Dir::operator=(const Dir& other) = default;
Dir::~Dir() = default;

bool Dir::Exists() const
{
    return GetFileStatus(mPath).IsDirectory();
}

void Dir::Create() const
{
    int error = GetFileStatus(mPath).mError;
    if (error == ENOENT)
    {
        if (const UTF16String parent = ParentOf(mPath); !parent.empty())
            Dir(parent).Create();
        error = mkdir(ToNativePath(mPath).c_str(), kForUserAlone) == 0 ? 0 : errno;
    }
    // Somebody else may have made it in between, and what is there may be a file.
    if (!Exists())
        throw file_exception("cannot make folder", mPath, error == 0 ? ENOTDIR : error);
}

Dir Dir::AppDir()
{
    return Dir(ApplicationDirectory());
}

Dir Dir::PrefDir()
{
    const Dir& other = PrefDirOverride();
    return other.mPath.empty() ? Dir(UserPreferenceDirectory()) : other;
}

void Dir::SetPrefDir(const Dir& dir)
{
    PrefDirOverride() = dir;
}

} // namespace zebcore::filesupport
