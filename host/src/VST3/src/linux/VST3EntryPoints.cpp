#include "host/src/VST3/src/VST3EntryPoints.h"

namespace zebaudiofilterhost::vst3
{

const std::vector<VST3EntryPoints>& GetVST3EntryPoints()
{
    // Some plug-ins are ports that kept the names of the other system.
    static const std::vector<VST3EntryPoints> sEntryPoints = {{"ModuleEntry", "ModuleExit"},
                                                              {"bundleEntry", "bundleExit"}};
    return sEntryPoints;
}

} // namespace zebaudiofilterhost::vst3
