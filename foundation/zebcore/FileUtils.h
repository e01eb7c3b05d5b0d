#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

namespace zebcore::utility::FileUtils
{

/// Writes the text as the whole content of the file, which is made if it is missing. Throws
/// filesupport::file_exception; the file is incomplete then, so write to the temporary file of a SafeSave what must
/// not be lost. [any]
ZEB_EXPORT void SimpleWriteStringToFile(const UTF16String& path, const UTF8String& text);

/// The whole content of the file, whatever its bytes are. Throws filesupport::file_exception, also for more than 2
/// GiB. [any]
ZEB_EXPORT UTF8String SimpleReadStringFromFile(const UTF16String& path);

} // namespace zebcore::utility::FileUtils
