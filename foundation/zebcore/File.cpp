#include "foundation/zebcore/File.h"

#include "foundation/zebcore/internal/FileStatus.h"
#include "foundation/zebcore/internal/Paths.h"

namespace zebcore::filesupport
{

File::File(const UTF16String& path) : mPath(WithoutTrailingSlashes(path))
{
}

File::File(const Dir& dir, const UTF16String& name) : mPath(Join(dir.FullPath(), name))
{
}

File::~File() = default;

bool File::Exists() const
{
    const FileStatus status = GetFileStatus(mPath);
    return status.mError == 0 && !status.IsDirectory();
}

UTF16String File::GetName() const
{
    return UTF16String(LastComponent(mPath));
}

UTF16String File::GetTitle() const
{
    const std::u16string_view name = LastComponent(mPath);
    const std::size_t dot = name.rfind(u'.');
    return UTF16String(dot == std::u16string_view::npos || dot == 0 ? name : name.substr(0, dot));
}

Dir File::GetDir() const
{
    return Dir(ParentOf(mPath));
}

} // namespace zebcore::filesupport
