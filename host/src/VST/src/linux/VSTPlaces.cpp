#include "host/src/VST/src/VSTPlaces.h"

#include "host/src/linux/SearchPath.h"

namespace zebaudiofilterhost::vst
{

std::vector<Dir> GetVSTPlaces()
{
    return GetSearchPath("VST_PATH", {"/usr/lib/vst", "/usr/lib/lxvst", "/usr/local/lib/vst", "~/.vst", "~/.lxvst"});
}

} // namespace zebaudiofilterhost::vst
