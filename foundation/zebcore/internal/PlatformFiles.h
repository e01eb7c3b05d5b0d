#pragma once

#include "foundation/zebcore/StringTypes.h"

// What differs between the platforms. None of it fails: where the system has no answer, the root directory stands in.
namespace zebcore::filesupport
{

// Forces what was written to the descriptor's file out to the disk itself. Result and errno as fsync's.
int FlushToDisk(int descriptor);

UTF16String ApplicationDirectory();
UTF16String UserPreferenceDirectory();

} // namespace zebcore::filesupport
