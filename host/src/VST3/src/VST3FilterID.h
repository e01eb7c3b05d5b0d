#pragma once

#include "utility/CommonTypes.h"

#include <pluginterfaces/base/funknown.h>

namespace zebaudiofilterhost::vst3
{

/// The text under which settings, presets and the catalogue know a class: "3:" and the class ID as four words in
/// lower-case hexadecimal, of which only the first is padded. [any]
UTF16String EncodeFilterID(const Steinberg::TUID classID);

/// Every text gives some class ID: what cannot be read of it is 0, and a prefix of two units is optional. [any]
void DecodeFilterID(const UTF16String& filterID, Steinberg::TUID classID);

} // namespace zebaudiofilterhost::vst3
