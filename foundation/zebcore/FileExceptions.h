#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <stdexcept>
#include <string_view>

namespace zebcore::filesupport
{

/// A file operation failed. what() is a sentence in UTF-8 that names the file and the reason.
class ZEB_EXPORT file_exception : public std::runtime_error
{
public:
    /// `action` is what could not be done, such as "cannot write"; `error` is a system error number.
    file_exception(std::string_view action, const UTF16String& path, int error);

    /// For reasons that the system has no number for. Error() is 0 then.
    file_exception(std::string_view action, const UTF16String& path, std::string_view reason);

    ~file_exception() override;

    const UTF16String& Path() const noexcept { return mPath; }
    int Error() const noexcept { return mError; }

private:
    UTF16String mPath;
    int mError = 0;
};

/// The new file is complete, but the system refuses to give up the old one: it is immutable, a mount point, or
/// somebody else's in a sticky folder. Every other failure of a save, a full disk above all, is a plain
/// file_exception.
class ZEB_EXPORT file_delete_exception : public file_exception
{
public:
    using file_exception::file_exception;
    ~file_delete_exception() override;
};

} // namespace zebcore::filesupport
