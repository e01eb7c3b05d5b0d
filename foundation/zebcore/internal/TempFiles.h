#pragma once

#include "foundation/zebcore/File.h"

namespace zebcore::filesupport
{

// Makes an empty file beside the target, of a name that no other process uses. It has the permissions of any new
// file, or, `forUserAlone`, is open to nobody else. Throws file_exception.
File MakeTempFile(const File& target, bool forUserAlone);

// Removes what processes that were killed while they saved the target have left behind.
void RemoveAbandonedTempFiles(const File& target) noexcept;

} // namespace zebcore::filesupport
