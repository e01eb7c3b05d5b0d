#include "host/src/VST/src/VSTPluginSearch.h"

#include "host/VST/VSTTechnology.h"
#include "host/src/PluginSearch.h"
#include "host/src/VST/src/VSTPlaces.h"
#include "host/src/VST/src/VSTPluginFiles.h"

namespace zebaudiofilterhost::vst
{

namespace
{

constexpr PluginSearchRules kRules = {.mType = kTechnologyVST,
                                      .mBundleExtension = u".vst",
                                      .mIsBundle = IsBundleName,
                                      .mIsSearched = IsSearchedDirectory,
                                      .mFindFiles = FindPluginFiles};
constexpr const char16_t* kPrivateDirectory = u"Plug-Ins/VST";

} // namespace

std::vector<PluginLocator> GetPotentialPluginLocators(const Dir& directory)
{
    return SearchForPlugins({directory}, kRules);
}

std::vector<UTF16String> GetDefaultVSTPluginDirectories()
{
    std::vector<UTF16String> directories;
    for (const Dir& place : GetVSTPlaces())
        directories.push_back(place.FullPath());
    return directories;
}

UTF16String GetPrivateVSTPluginDirectory()
{
    return Dir(Dir::AppDir(), kPrivateDirectory).FullPath();
}

UTF16String GetPathDisplayString(const UTF16String& path)
{
    return path;
}

bool IsVSTPlugin(const UTF16String& path)
{
    return IsNamedAsBundle(path, kRules) ? Dir(path).Exists() : IsPluginFile(path);
}

} // namespace zebaudiofilterhost::vst
