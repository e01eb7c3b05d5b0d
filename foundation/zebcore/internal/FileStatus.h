#pragma once

#include "foundation/zebcore/StringTypes.h"

#include <sys/stat.h>

namespace zebcore::filesupport
{

struct FileStatus
{
    bool IsDirectory() const { return mError == 0 && S_ISDIR(mStat.st_mode); }
    bool IsSameFile(const FileStatus& other) const
    {
        return mStat.st_dev == other.mStat.st_dev && mStat.st_ino == other.mStat.st_ino;
    }

    int mError = 0; // 0: there is such a file, and mStat describes it
    struct stat mStat = {};
};

// Of the file that the path leads to, through links.
FileStatus GetFileStatus(const UTF16String& path);

} // namespace zebcore::filesupport
