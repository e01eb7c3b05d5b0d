#include "host/src/VST3/src/VST3Places.h"

#include "host/src/mac/MacLibraryFolder.h"

namespace zebaudiofilterhost::vst3
{

namespace
{

constexpr const char16_t* kVST3DirectorySuffix = u"Audio/Plug-Ins/VST3";

} // namespace

std::vector<Dir> GetVST3Places()
{
    return {Dir(GetMacLibraryFolder(true), kVST3DirectorySuffix),
            Dir(GetMacLibraryFolder(false), kVST3DirectorySuffix)};
}

} // namespace zebaudiofilterhost::vst3
