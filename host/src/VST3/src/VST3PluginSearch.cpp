#include "host/src/VST3/src/VST3PluginSearch.h"

#include "foundation/zebcore/NativePath.h"
#include "host/BannedPluginManager.h"
#include "host/VST3/VST3Technology.h"
#include "host/src/VST3/src/VST3Places.h"

#include <filesystem>
#include <set>
#include <system_error>

namespace zebaudiofilterhost::vst3
{

namespace
{

constexpr const char16_t* kBundleExtension = u".vst3";
constexpr const char16_t* kPrivateDirectory = u"Plug-Ins/VST3";

// Directories that were searched, by what they are and not by how they were reached: links can make a tree of few
// directories endless, or of exponential size.
class SearchedDirectories
{
public:
    // False if the directory was added before, or cannot be reached.
    bool Add(const Dir& dir)
    {
        std::error_code error;
        const auto real = std::filesystem::canonical(zebcore::filesupport::ToNativePath(dir.FullPath()), error);
        return !error && mPaths.insert(real.native()).second;
    }

private:
    std::set<std::filesystem::path::string_type> mPaths;
};

void AddBundle(const UTF16String& path, std::vector<PluginLocator>& locators)
{
    const PluginLocator locator(kTechnologyVST3, path);
    if (!BannedPluginManager::GetInstance().IsPluginBanned(locator))
        locators.push_back(locator);
}

// Adds the bundles of one directory to the result, and its other sub-directories to the stack.
void SearchDirectory(const Dir& dir, std::vector<PluginLocator>& locators, std::vector<Dir>& stack)
{
    const Dir::DirIterator end = dir.EndSubdirs();
    for (Dir::DirIterator subdir = dir.BeginSubdirs(false, nullptr, {}); subdir != end; ++subdir)
    {
        const UTF16String path = (*subdir).FullPath();
        if (path.ends_with(kBundleExtension))
            AddBundle(path, locators);
        else
            stack.push_back(*subdir);
    }
}

} // namespace

std::vector<PluginLocator> GetPotentialPluginLocators(const Dir&)
{
    const std::vector<Dir> places = GetVST3Places();
    std::vector<Dir> stack(places.rbegin(), places.rend());
    std::vector<PluginLocator> locators;
    SearchedDirectories searched;
    while (!stack.empty())
    {
        const Dir dir = stack.back();
        stack.pop_back();
        if (dir.Exists() && searched.Add(dir))
            SearchDirectory(dir, locators, stack);
    }
    return locators;
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
