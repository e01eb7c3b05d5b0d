#include "host/src/VST/src/VSTPlaces.h"

#include "host/src/mac/MacLibraryFolder.h"

namespace zebaudiofilterhost::vst
{

namespace
{

constexpr const char16_t* kVSTDirectorySuffix = u"Audio/Plug-Ins/VST";

} // namespace

std::vector<Dir> GetVSTPlaces()
{
    return {Dir(GetMacLibraryFolder(false), kVSTDirectorySuffix),
            Dir(GetMacLibraryFolder(true), kVSTDirectorySuffix)};
}

} // namespace zebaudiofilterhost::vst
