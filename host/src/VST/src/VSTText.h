#pragma once

#include "foundation/zebcore/CaseInsensitive.h"

#include <algorithm>
#include <cstddef>
#include <span>
#include <string_view>

namespace zebaudiofilterhost::vst
{

/// Room for a short text of a plug-in's: many write more than the published length.
inline constexpr std::size_t kTextBufferSize = 128;

/// What a plug-in wrote into an array, which may lack the terminator. [any]
inline std::string_view BoundedText(std::span<const char> bytes)
{
    return {bytes.begin(), std::find(bytes.begin(), bytes.end(), '\0')};
}

/// Whether the text that a plug-in asks with is this one, without regard to the case of letters. False for null.
/// [any]
inline bool EqualsText(const void* asked, std::string_view text)
{
    const std::string_view question(asked != nullptr ? static_cast<const char*>(asked) : "");
    // Not of a locale: the first use of one in a process calls the system.
    constexpr zebcore::utility::CaseInsensitive::EqualChar<char> equal;
    return asked != nullptr && std::equal(question.begin(), question.end(), text.begin(), text.end(), equal);
}

} // namespace zebaudiofilterhost::vst
