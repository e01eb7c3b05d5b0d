#pragma once

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// Names of the functions that a bundle exports to be told that its life in this process begins and ends. Both are
/// optional.
struct VST3EntryPoints
{
    const char* mEntry; ///< takes what zebcore::utility::GetOSModuleHandle gives
    const char* mExit;  ///< takes nothing
};

/// In the order in which they are tried; the first that a bundle exports is the one. [any]
const std::vector<VST3EntryPoints>& GetVST3EntryPoints();

} // namespace zebaudiofilterhost::vst3
