#pragma once

#include <array>

namespace zebaudiofilterhost::vst
{

/// The names of the function that makes a plug-in; the first that a binary exports counts.
inline constexpr std::array<const char*, 2> kEntryPoints = {"VSTPluginMain", "main_macho"};

} // namespace zebaudiofilterhost::vst
