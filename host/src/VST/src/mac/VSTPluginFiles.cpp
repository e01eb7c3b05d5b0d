#include "host/src/VST/src/VSTPluginFiles.h"

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

bool IsSearchedDirectory(const UTF16String&)
{
    return true;
}

UTF16String FindPluginProblem(const UTF16String&)
{
    return {};
}

} // namespace zebaudiofilterhost::vst
