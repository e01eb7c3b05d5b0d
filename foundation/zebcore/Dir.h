#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <boost/function.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>

#include <cstddef>
#include <memory>
#include <vector>

namespace zebcore::filesupport
{

/// The path of a directory, as a value. Only Exists, Create and the iteration touch the disk. A default-made Dir has
/// an empty path and exists nowhere. [any]
class ZEB_EXPORT Dir
{
public:
    class DirIterator;

    Dir();
    explicit Dir(const UTF16String& path);
    Dir(const Dir& other);
    Dir(const Dir& parent, const UTF16String& subPath);
    Dir& operator=(const Dir& other);
    ~Dir();

    bool Exists() const;

    /// The path as it was given, without a trailing slash. A relative path stays relative.
    UTF16String FullPath() const { return mPath; }

    /// Makes the directory and what is missing above it, for the user alone. Throws file_exception.
    void Create() const;

    /// The directory of the application: of its executable, on macOS of its bundle.
    static Dir AppDir();

    /// The directory of the user's preference files. It may not exist yet: saving a property list makes it.
    static Dir PrefDir();

    /// Sets another directory of preference files; an empty one restores the user's own. [main]
    static void SetPrefDir(const Dir& dir);

    /// Walks the sub-directories in a fixed order, that of their names by code unit or, unless it is null, that of
    /// `order`, a "less than" on names. Links to directories count, except those that lead back to this directory or
    /// one above it, since such a walk would never end. What can't be read is left out. With `recursive` the
    /// sub-directories of each follow it. `goOn`, which may be null, is asked between directories and ends the walk
    /// when it returns false. What the iterator yields is what was there at the call.
    DirIterator
    BeginSubdirs(bool recursive, boost::function<bool()>* goOn,
                 boost::shared_ptr<boost::function<bool(const UTF16String&, const UTF16String&)>> order) const;
    DirIterator EndSubdirs() const;

private:
    UTF16String mPath;
};

/// An input iterator over the sub-directories of a Dir.
class ZEB_EXPORT Dir::DirIterator
{
public:
    ~DirIterator();

    Dir operator*() const;
    DirIterator& operator++();
    bool operator!=(const DirIterator& other) const;

private:
    friend class Dir;

    using Paths = std::vector<UTF16String>;

    explicit DirIterator(std::shared_ptr<const Paths> paths);

    bool IsAtEnd() const;

    std::shared_ptr<const Paths> mPaths; // null at the end
    std::size_t mIndex = 0;
};

} // namespace zebcore::filesupport
