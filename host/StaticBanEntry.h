#pragma once

#include "utility/CommonTypes.h"

namespace zebaudiofilterhost
{

/// One line of the permanent block list: which plug-in file is known not to work.
struct StaticBanEntry
{
    UTF16String fileName; // with extension; never empty
    UTF16String uniqueID; // empty means any
    UTF16String version;  // empty means any
};

} // namespace zebaudiofilterhost
