#include "host/src/VST/src/VSTEntryPoints.h"

#include <array>

namespace zebaudiofilterhost::vst
{

std::span<const char* const> GetVSTEntryPoints()
{
    static constexpr std::array<const char*, 2> sNames = {"VSTPluginMain", "main_macho"};
    return sNames;
}

} // namespace zebaudiofilterhost::vst
