#include "host/src/VST3/src/VST3PluginSearch.h"

#include "host/VST3/VST3Technology.h"
#include "host/src/PluginSearch.h"
#include "host/src/VST3/src/VST3Places.h"

namespace zebaudiofilterhost::vst3
{

namespace
{

constexpr PluginSearchRules kRules = {.mType = kTechnologyVST3, .mBundleExtension = u".vst3"};
constexpr const char16_t* kPrivateDirectory = u"Plug-Ins/VST3";

} // namespace

std::vector<PluginLocator> GetPotentialPluginLocators(const Dir&)
{
    return SearchForPlugins(GetVST3Places(), kRules);
}

std::vector<UTF16String> GetDefaultVST3PluginDirectories()
{
    return {};
}

UTF16String GetPrivateVST3PluginDirectory()
{
    return Dir(Dir::AppDir(), kPrivateDirectory).FullPath();
}

UTF16String GetPathDisplayString(const UTF16String& path)
{
    return path;
}

} // namespace zebaudiofilterhost::vst3
