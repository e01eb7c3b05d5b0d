#pragma once

#include "CoreFoundation/CFBase.h"

#include <span>

namespace zebaudiofilterhost::xau::cf
{

/// Whether a text of a list, in whichever form, has a zero in it: the parser ends the process at one.
bool HasZeroInText(std::span<const UInt8> bytes);

} // namespace zebaudiofilterhost::xau::cf
