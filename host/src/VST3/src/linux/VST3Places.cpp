#include "host/src/VST3/src/VST3Places.h"

#include "host/src/linux/SearchPath.h"

namespace zebaudiofilterhost::vst3
{

std::vector<Dir> GetVST3Places()
{
    return GetSearchPath("VST3_PATH", {"~/.vst3", "/usr/local/lib/vst3", "/usr/lib/vst3"});
}

} // namespace zebaudiofilterhost::vst3
