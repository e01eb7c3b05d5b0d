#include "host/src/VST/src/VSTPluginFiles.h"

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/OSModule.h"
#include "host/src/VST/src/VSTEntryPoints.h"
#include "host/src/VST/src/linux/ElfExports.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string_view>
#include <system_error>

namespace zebaudiofilterhost::vst
{

namespace
{

namespace fs = std::filesystem;

constexpr const char* kFileExtension = ".so";
constexpr std::u16string_view kForeignBundles[] = {u".vst3", u".lv2", u".clap"};

std::vector<const char*> FindEntryPointsOf(ElfExports& exports)
{
    const std::span<const char* const> names = GetVSTEntryPoints();
    std::vector<const char*> found;
    std::copy_if(names.begin(), names.end(), std::back_inserter(found),
                 [&exports](const char* name) { return exports.HasFunction(name); });
    return found;
}

// Null, or the end of a sentence that the path begins.
const char16_t* FindFileProblem(const fs::path& path)
{
    std::error_code error;
    if (!fs::is_regular_file(path, error)) // anything else might block when it is opened
        return u" is not a file.";
    std::ifstream file(path, std::ios::binary);
    if (!file)
        return u" cannot be read.";
    ElfExports exports(file);
    if (exports.GetKind() == ElfKind::kNoLibrary)
        return u" is not a shared library.";
    if (exports.GetKind() == ElfKind::kOtherMachine)
        return u" is a binary for another kind of machine.";
    return FindEntryPointsOf(exports).empty() ? kNoEntryPoint : nullptr;
}

bool IsPlugin(const fs::path& path)
{
    return path.extension() == kFileExtension && FindFileProblem(path) == nullptr;
}

} // namespace

bool IsPluginFile(const UTF16String& path)
{
    return IsPlugin(zebcore::filesupport::ToNativePath(path));
}

std::vector<UTF16String> FindPluginFiles(const Dir& directory)
{
    std::vector<fs::path> found;
    std::error_code error;
    fs::directory_iterator entry(zebcore::filesupport::ToNativePath(directory.FullPath()), error);
    for (; !error && entry != fs::directory_iterator(); entry.increment(error))
    {
        if (IsPlugin(entry->path()))
            found.push_back(entry->path());
    }
    std::sort(found.begin(), found.end());
    std::vector<UTF16String> paths;
    for (const fs::path& path : found)
        paths.push_back(zebcore::filesupport::FromNativePath(path.native()));
    return paths;
}

// The folder ~/.vst, where users keep their plug-ins, has its extension for a name.
bool IsBundleName(const UTF16String& path)
{
    return !path.ends_with(u"/.vst");
}

bool IsSearchedDirectory(const UTF16String& path)
{
    return std::none_of(std::begin(kForeignBundles), std::end(kForeignBundles),
                        [&path](std::u16string_view extension) { return path.ends_with(extension); });
}

std::vector<const char*> FindEntryPoints(const UTF16String& path)
{
    const UTF16String binary = zebcore::utility::FindOSModuleBinary(path);
    std::ifstream file(zebcore::filesupport::ToNativePath(binary), std::ios::binary);
    ElfExports exports(file);
    return FindEntryPointsOf(exports);
}

UTF16String FindPluginProblem(const UTF16String& path)
{
    const UTF16String binary = zebcore::utility::FindOSModuleBinary(path);
    if (binary.empty())
        return zebcore::utility::GetLastOSModuleError();
    const char16_t* problem = FindFileProblem(zebcore::filesupport::ToNativePath(binary));
    return problem ? u"\"" + path + u"\"" + problem : UTF16String();
}

} // namespace zebaudiofilterhost::vst
