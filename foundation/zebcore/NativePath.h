#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <string>
#include <string_view>

/// Paths as the system's calls take them. A file name is a row of bytes and need not be UTF-8: a byte that isn't
/// stands in the text as the lone surrogate 0xDC00 + byte, so that every file that is found can also be opened.
namespace zebcore::filesupport
{

/// [any]
ZEB_EXPORT std::string ToNativePath(const UTF16String& path);
ZEB_EXPORT UTF16String FromNativePath(std::string_view path);

} // namespace zebcore::filesupport
