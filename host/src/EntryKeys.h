#pragma once

#include "foundation/zebcore/StringTypes.h"

namespace zebaudiofilterhost
{

// The keys that a stored filter and a stored plug-in have in common.
inline const UTF8String kKey_Locator = u8"locator";
inline const UTF8String kKey_Name = u8"name";
inline const UTF8String kKey_Vendor = u8"vendor";
inline const UTF8String kKey_Version = u8"version";
inline const UTF8String kKey_Enabled = u8"enabled";

} // namespace zebaudiofilterhost
