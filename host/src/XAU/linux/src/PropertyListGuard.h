#pragma once

#include "CoreFoundation/CFBase.h"

#include <cstddef>
#include <span>

namespace zebaudiofilterhost::xau::cf
{

/// Longer lists are refused.
inline constexpr std::size_t kMaxPropertyListSize = std::size_t{64} << 20U;

/// Lists of more nodes are refused. An object that a list has at several places counts at each.
inline constexpr std::size_t kMaxPropertyListNodes = 1'000'000;

/// Whether the parser may have the bytes of a list, in whichever form. It ends the process at a zero in a text and at
/// deep nesting, and makes a copy of an object for each reference to it.
bool IsSafeToParse(std::span<const UInt8> bytes);

} // namespace zebaudiofilterhost::xau::cf
