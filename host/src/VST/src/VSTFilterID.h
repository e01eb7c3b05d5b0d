#pragma once

#include "utility/CommonTypes.h"

namespace zebaudiofilterhost::vst
{

/// The text under which settings, presets and the catalogue know an effect: "2:", its unique ID in unsigned decimal,
/// a blank, and the file title of its binary. [any]
UTF16String EncodeFilterID(unsigned int uniqueID, const UTF16String& path);

/// Reads the number; a prefix of two units is optional, and the title is not looked at. `uniqueID` stays as it is
/// when there is no number, or one beyond 32 bits. [any]
void DecodeFilterID(const UTF16String& filterID, unsigned int& uniqueID);

} // namespace zebaudiofilterhost::vst
