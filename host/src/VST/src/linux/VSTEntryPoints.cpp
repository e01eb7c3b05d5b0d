#include "host/src/VST/src/VSTEntryPoints.h"

#include <array>

namespace zebaudiofilterhost::vst
{

std::span<const char* const> GetVSTEntryPoints()
{
    // Plug-ins of some frameworks export "main" alone. It comes last, for it says the least.
    static constexpr std::array<const char*, 3> sNames = {"VSTPluginMain", "main_macho", "main"};
    return sNames;
}

} // namespace zebaudiofilterhost::vst
