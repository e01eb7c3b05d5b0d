#include "host/src/VST/src/VSTPluginFiles.h"

#include "host/src/VST/src/VSTEntryPoints.h"

namespace zebaudiofilterhost::vst
{

// Plug-ins are bundles and nothing else, whose code is loaded only when an entry point is looked up.

bool IsPluginFile(const UTF16String&)
{
    return false;
}

std::vector<UTF16String> FindPluginFiles(const Dir&)
{
    return {};
}

bool IsBundleName(const UTF16String&)
{
    return true;
}

bool IsSearchedDirectory(const UTF16String&)
{
    return true;
}

std::vector<const char*> FindEntryPoints(const UTF16String&)
{
    const std::span<const char* const> names = GetVSTEntryPoints();
    return {names.begin(), names.end()};
}

UTF16String FindPluginProblem(const UTF16String&)
{
    return {};
}

} // namespace zebaudiofilterhost::vst
