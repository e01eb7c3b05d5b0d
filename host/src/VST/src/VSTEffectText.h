#pragma once

#include "utility/CommonTypes.h"

namespace zebaudiofilterhost::vst
{

struct AEffect;

/// What an effect calls itself, its maker and its product; empty if it does not say. `effect` must not be null. A
/// plug-in that throws has said nothing more. [main]
UTF16String GetEffectName(AEffect* effect);
UTF16String GetVendorString(AEffect* effect);
UTF16String GetProductString(AEffect* effect);

} // namespace zebaudiofilterhost::vst
