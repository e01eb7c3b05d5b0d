#include "catalogue/PluginFinder.h"

#include "catalogue/UnitBundle.h"
#include "cli/Failure.h"
#include "cli/StartFolder.h"
#include "output/PrintableText.h"

#include <foundation/zebcore/NativePath.h>
#include <host/PluginModuleInfoManager.h>
#include <host/TechnologyType.h>
#include <host/VST/VSTTechnology.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <set>
#include <sstream>
#include <utility>

namespace zebhost
{

namespace fs = std::filesystem;

using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;
using zebaudiofilterhost::TechnologyType;
using zebcore::filesupport::FromNativePath;
using zebcore::filesupport::ToNativePath;

namespace
{

constexpr std::array<std::pair<const char*, TechnologyType>, 4> kExtensions = {
    {{".vst3", zebaudiofilterhost::kTechnologyVST3},
     {".vst", zebaudiofilterhost::kTechnologyVST},
     {".so", zebaudiofilterhost::kTechnologyVST},
     {".component", zebaudiofilterhost::kTechnologyAudioUnit}}};

// Bundles of other standards. Their binaries may export a VST 2 entry point too.
constexpr std::array<const char*, 2> kForeignExtensions = {".lv2", ".clap"};

TechnologyType TechnologyOf(const fs::path& path)
{
    const std::string extension = path.extension().string();
    for (const auto& [known, type] : kExtensions)
    {
        if (extension == known && PluginModuleInfoManager::GetInstance().GetPluginTechnology(type) != nullptr)
        {
            return type;
        }
    }
    return zebaudiofilterhost::kTechnologyNone;
}

// "1635083896 2053595497 2053464696" as "aufx zgai zebx". Codes of other characters than visible ones stay numbers.
std::string SpelledCodes(const std::string& id)
{
    std::istringstream numbers(id);
    std::string spelled;
    for (std::uint32_t code = 0; numbers >> code;)
    {
        std::string characters;
        for (int shift = 24; shift >= 0; shift -= 8)
        {
            characters += static_cast<char>(code >> shift & 0xFFU);
        }
        const bool isVisible =
            std::all_of(characters.begin(), characters.end(), [](char each) { return each >= ' ' && each <= '~'; });
        spelled += (spelled.empty() ? "" : " ") + (isVisible ? characters : std::to_string(code));
    }
    return spelled.empty() ? id : spelled;
}

fs::path Normal(const fs::path& path)
{
    const fs::path normal = fs::absolute(startfolder::Resolve(path)).lexically_normal();
    return normal.has_filename() ? normal : normal.parent_path();
}

// Folders to search, bundles, and the plug-ins that are plain files, of which a name alone tells nothing.
bool IsWorthVisiting(const fs::directory_entry& entry)
{
    std::error_code ignored;
    if (entry.is_directory(ignored))
    {
        return std::find(kForeignExtensions.begin(), kForeignExtensions.end(), entry.path().extension()) ==
               kForeignExtensions.end();
    }
    return zebaudiofilterhost::vst::IsVSTPlugin(FromNativePath(entry.path().string()));
}

void CheckReadable(const fs::path& path, const std::error_code& error)
{
    if (error)
    {
        throw Failure(ExitCode::FileTrouble,
                      path.string() + " cannot be read: " + error.message() + "; make it readable");
    }
}

// A link back to a folder above would never end, so each real folder is searched once.
void SearchFolder(const fs::path& folder, std::set<fs::path>& seen, std::vector<PluginLocator>& found)
{
    std::error_code error;
    if (!seen.insert(fs::canonical(folder, error)).second || error)
    {
        return;
    }
    std::vector<fs::path> children;
    for (fs::directory_iterator at(folder, fs::directory_options::skip_permission_denied, error), end;
         !error && at != end; at.increment(error))
    {
        if (IsWorthVisiting(*at))
        {
            children.push_back(at->path());
        }
    }
    std::sort(children.begin(), children.end());
    for (const fs::path& child : children)
    {
        if (IsBundlePath(child))
        {
            const std::vector<PluginLocator> inside = PluginsAt(child);
            found.insert(found.end(), inside.begin(), inside.end());
        }
        else
        {
            SearchFolder(child, seen, found);
        }
    }
}

} // namespace

const char* const kPluginNameEnds = ".vst3, .vst, .component or .so";
const char* const kHoldsNoUnit =
    " tells of no effect: its Contents/Info.plist lists no unit that is an effect, a mixer or a panner, or is no XML";

bool IsBundlePath(const fs::path& path)
{
    return TechnologyOf(Normal(path)) != zebaudiofilterhost::kTechnologyNone;
}

std::vector<PluginLocator> PluginsAt(const fs::path& path)
{
    const fs::path normal = Normal(path);
    switch (const TechnologyType type = TechnologyOf(normal))
    {
    case zebaudiofilterhost::kTechnologyNone:
        return {};
    case zebaudiofilterhost::kTechnologyAudioUnit:
        return UnitsOf(normal);
    default:
        return {{type, FromNativePath(normal.string())}};
    }
}

std::string PathOf(const PluginLocator& locator)
{
    return ToNativePath(locator.GetPath());
}

std::string PlaceOf(const PluginLocator& locator)
{
    const std::string path = PathOf(locator);
    if (locator.GetTechnologyType() != zebaudiofilterhost::kTechnologyAudioUnit)
    {
        return path;
    }
    const auto technology =
        PluginModuleInfoManager::GetInstance().GetPluginTechnology(zebaudiofilterhost::kTechnologyAudioUnit);
    const std::string name =
        technology != nullptr ? Printable(technology->GetPathDisplayString(locator.GetPath())) : path;
    return name == path ? SpelledCodes(path) : name;
}

std::string SelectorOf(const PluginLocator& locator)
{
    return locator.GetTechnologyType() == zebaudiofilterhost::kTechnologyAudioUnit ? "4:" + PathOf(locator)
                                                                                   : PathOf(locator);
}

std::string ShellWord(const std::string& text)
{
    return text.find(' ') == std::string::npos ? text : '"' + text + '"';
}

std::string SelectorWord(const PluginLocator& locator)
{
    return ShellWord(SelectorOf(locator));
}

bool IsCalled(const PluginLocator& locator, const std::string& text)
{
    return locator.GetTechnologyType() == zebaudiofilterhost::kTechnologyAudioUnit
               ? PlaceOf(locator) == text
               : fs::path(PathOf(locator)).filename() == text;
}

bool IsInstalled(const PluginLocator& locator)
{
    const TechnologyType type = locator.GetTechnologyType();
    const auto technology = PluginModuleInfoManager::GetInstance().GetPluginTechnology(type);
    if (technology != nullptr && type == zebaudiofilterhost::kTechnologyAudioUnit) // names in a registry
    {
        const std::vector<PluginLocator> found = technology->CollectPlugins();
        return std::find(found.begin(), found.end(), locator) != found.end();
    }
    std::error_code error;
    return fs::exists(PathOf(locator), error);
}

std::vector<PluginLocator> FindPlugins(const fs::path& path)
{
    std::error_code error;
    if (!fs::exists(startfolder::Resolve(path), error))
    {
        CheckReadable(path, error);
        throw Failure(ExitCode::NotFound, path.string() + ": there is nothing at this path; check its spelling");
    }
    if (IsBundlePath(path))
    {
        std::vector<PluginLocator> plugins = PluginsAt(path);
        if (plugins.empty())
        {
            throw Failure(ExitCode::NotFound, path.string() + kHoldsNoUnit);
        }
        return plugins;
    }
    if (!fs::is_directory(startfolder::Resolve(path), error))
    {
        throw Failure(ExitCode::NotFound, path.string() +
                                              " is no plug-in: give a bundle or file whose name ends in " +
                                              kPluginNameEnds + ", or a folder that holds such");
    }
    static_cast<void>(fs::directory_iterator(startfolder::Resolve(path), error));
    CheckReadable(path, error);
    std::vector<PluginLocator> found;
    std::set<fs::path> seen;
    SearchFolder(Normal(path), seen, found);
    return found;
}

void UseStandardPlaces()
{
    PluginModuleInfoManager::GetInstance().ResetToDefaultFolders();
}

std::vector<PluginLocator> WithoutDoubles(const std::vector<PluginLocator>& locators)
{
    std::vector<PluginLocator> result;
    std::set<std::pair<TechnologyType, std::string>> seen;
    for (const PluginLocator& locator : locators)
    {
        std::error_code error;
        const fs::path real = fs::canonical(PathOf(locator), error);
        if (seen.emplace(locator.GetTechnologyType(), error ? PathOf(locator) : real.string()).second)
        {
            result.push_back(locator);
        }
    }
    return result;
}

} // namespace zebhost
