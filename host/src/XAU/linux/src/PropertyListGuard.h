#pragma once

#include "CoreFoundation/CFBase.h"

#include <cstddef>
#include <span>

namespace zebaudiofilterhost::xau::cf
{

/// Longer lists in XML are refused, and lists in binary form whose texts and bytes come to more at all their places.
inline constexpr std::size_t kMaxPropertyListSize = std::size_t{64} << 20U;

/// So many times its own length is allowed to a list in binary form that is long itself, as one with a unit's samples
/// is: what is the same at several places is in it once. What is read stays in proportion to it.
inline constexpr std::size_t kMaxPropertyListCopies = 4;

/// Lists of more nodes are refused. An object that a list has at several places counts at each.
inline constexpr std::size_t kMaxPropertyListNodes = 1'000'000;

/// Whether the parser may have the bytes of a list, in whichever form. It ends the process at a zero in a text and at
/// deep nesting, and makes a copy of an object for each reference to it.
bool IsSafeToParse(std::span<const UInt8> bytes);

} // namespace zebaudiofilterhost::xau::cf
