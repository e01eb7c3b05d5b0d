#pragma once

#include "foundation/zebcore/StringTypes.h"

#include <pluginterfaces/base/ftypes.h>

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>

namespace zebaudiofilterhost::vst3
{

/// Texts of plug-ins come in arrays of fixed size and may lack the terminator. [any]
template <class Unit, std::size_t N>
std::basic_string_view<Unit> BoundedText(const Unit (&units)[N])
{
    return {units, static_cast<std::size_t>(std::find(units, units + N, Unit()) - units)};
}

/// The whole array with its padding of zero units. [any]
template <std::size_t N>
zebcore::UTF16String PaddedText(const Steinberg::char16 (&units)[N])
{
    return {units, N};
}

} // namespace zebaudiofilterhost::vst3
