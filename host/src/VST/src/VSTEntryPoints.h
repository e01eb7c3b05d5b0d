#pragma once

#include <span>

namespace zebaudiofilterhost::vst
{

/// The names of the function that makes a plug-in, as this system's binaries export it; the first that is there
/// counts. [any]
std::span<const char* const> GetVSTEntryPoints();

inline constexpr const char16_t* kNoEntryPoint =
    u" is not a VST 2 plug-in: it exports no entry point such as VSTPluginMain.";

} // namespace zebaudiofilterhost::vst
