#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <cstddef>

namespace zebcore::filesupport
{

/// Compares two paths by the file system's rule for names: exactly on Linux, as the volume says on macOS. Negative,
/// zero or positive as `a` comes before, names the same file as, or comes after `b`. A strict ordering. [any]
ZEB_EXPORT int CompareFileNames(const UTF16String& a, const UTF16String& b);

/// Equal for paths that CompareFileNames takes as one. [any]
ZEB_EXPORT std::size_t HashFileName(const UTF16String& path);

} // namespace zebcore::filesupport
