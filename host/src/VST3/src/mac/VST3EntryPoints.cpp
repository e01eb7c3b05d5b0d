#include "host/src/VST3/src/VST3EntryPoints.h"

namespace zebaudiofilterhost::vst3
{

const std::vector<VST3EntryPoints>& GetVST3EntryPoints()
{
    static const std::vector<VST3EntryPoints> sEntryPoints = {{"bundleEntry", "bundleExit"}};
    return sEntryPoints;
}

} // namespace zebaudiofilterhost::vst3
