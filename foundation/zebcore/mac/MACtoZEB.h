#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <CoreFoundation/CoreFoundation.h>

namespace zebcore::utility
{

/// Converts a string of the system; null gives an empty string. The string stays the caller's. [any]
ZEB_EXPORT UTF16String MACtoZEB(CFStringRef text);

} // namespace zebcore::utility
