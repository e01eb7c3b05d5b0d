#include "foundation/zebcore/internal/FileStatus.h"

#include "foundation/zebcore/NativePath.h"

#include <cerrno>

namespace zebcore::filesupport
{

FileStatus GetFileStatus(const UTF16String& path)
{
    FileStatus status;
    // The system would stop at a zero unit, and speak of another file.
    if (path.find(u'\0') != UTF16String::npos)
        status.mError = EINVAL;
    else if (stat(ToNativePath(path).c_str(), &status.mStat) != 0)
        status.mError = errno;
    return status;
}

} // namespace zebcore::filesupport
