#pragma once

#include "foundation/zebcore/Dir.h"
#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

namespace zebcore::filesupport
{

/// The path of a file, as a value. Only Exists touches the disk. [any]
class ZEB_EXPORT File
{
public:
    explicit File(const UTF16String& path);
    File(const Dir& dir, const UTF16String& name);
    ~File();

    /// True if there is something that is not a directory.
    bool Exists() const;

    /// The path as it was given, without a trailing slash. A relative path stays relative.
    UTF16String FullPath() const { return mPath; }

    /// The last component of the path: the name with its extension.
    UTF16String GetName() const;

    /// The name without its extension, which is the last dot and what follows it. A dot that begins the name begins
    /// no extension.
    UTF16String GetTitle() const;

    /// The directory that holds the file; an empty Dir if the path has no directory.
    Dir GetDir() const;

private:
    UTF16String mPath;
};

} // namespace zebcore::filesupport
