#include "foundation/zebcore/internal/OSModulePlatform.h"

#include <dlfcn.h>

#include <algorithm>
#include <array>
#include <filesystem>
#include <fstream>
#include <string_view>
#include <vector>

namespace zebcore::utility::platform
{

namespace
{

namespace fs = std::filesystem;

#if defined(__x86_64__)
constexpr std::string_view kBinaryFolder = "x86_64-linux";
#elif defined(__aarch64__)
constexpr std::string_view kBinaryFolder = "aarch64-linux";
#elif defined(__i386__)
constexpr std::string_view kBinaryFolder = "i386-linux";
#elif defined(__riscv) && __riscv_xlen == 64
constexpr std::string_view kBinaryFolder = "riscv64-linux";
#else
#error "Say here how bundles call the folder of this machine's binaries"
#endif

std::string Quoted(const fs::path& path)
{
    return "\"" + path.string() + "\"";
}

/// "/a/X.vst3/" names the same bundle as "/a/X.vst3".
fs::path WithoutTrailingSlash(const fs::path& path)
{
    return path.has_filename() ? path : path.parent_path();
}

std::vector<fs::path> BinaryPlaces(const fs::path& bundle)
{
    const std::string title = bundle.stem().string();
    std::vector<fs::path> places{bundle / "Contents" / kBinaryFolder / (title + ".so")};
    // VST 2 bundles are a habit and no standard: some hold their binary beside everything else.
    if (bundle.extension() == ".vst")
    {
        places.push_back(bundle / (title + ".so"));
        places.push_back(bundle / (title + "-vst.so"));
    }
    return places;
}

/// The folders of a bundle that hold binaries for a system, such as "x86_64-win" or "MacOS".
std::vector<std::string> BinaryFolders(const fs::path& bundle)
{
    std::vector<std::string> folders;
    std::error_code error;
    for (const auto& entry : fs::directory_iterator(bundle / "Contents", error))
    {
        const std::string name = entry.path().filename().string();
        const bool isForSystem =
            name == "MacOS" || name.find("-win") != std::string::npos || name.ends_with("-linux");
        if (isForSystem && entry.is_directory(error))
            folders.push_back(name);
    }
    std::sort(folders.begin(), folders.end());
    return folders;
}

std::string WhyNoBinary(const fs::path& bundle)
{
    const std::string wanted = bundle.stem().string() + ".so";
    const std::vector<std::string> folders = BinaryFolders(bundle);
    if (folders.empty())
        return Quoted(bundle) + " is not a plug-in bundle: it has no Contents/" + std::string(kBinaryFolder) + "/" +
               wanted + ".";
    if (std::find(folders.begin(), folders.end(), kBinaryFolder) != folders.end())
        return Quoted(bundle) + " has a folder Contents/" + std::string(kBinaryFolder) + ", but no " + wanted +
               " in it.";

    std::string list = folders.front();
    for (std::size_t i = 1; i < folders.size(); ++i)
        list += (i + 1 == folders.size() ? " and " : ", ") + folders[i];
    return Quoted(bundle) + " holds no binary for " + std::string(kBinaryFolder) + ", only for " + list + ".";
}

bool IsWindowsBinary(const std::string& file)
{
    std::array<char, 2> magic{};
    std::ifstream(file, std::ios::binary).read(magic.data(), magic.size());
    return magic[0] == 'M' && magic[1] == 'Z';
}

} // namespace

std::string FindBinary(const std::string& path, std::string& failure)
{
    const fs::path bundle = WithoutTrailingSlash(path);
    std::error_code error;
    const fs::file_status status = fs::status(bundle, error);
    if (!fs::exists(status))
    {
        const bool isMissing = status.type() == fs::file_type::not_found;
        failure = Quoted(bundle) + (isMissing ? " does not exist." : " cannot be reached: " + error.message() + ".");
        return {};
    }
    if (!fs::is_directory(status))
        return path;

    for (const fs::path& place : BinaryPlaces(bundle))
    {
        if (fs::exists(place, error))
            return place.string();
    }
    failure = WhyNoBinary(bundle);
    return {};
}

void* OpenModule(const std::string& path, const std::string& binary, std::string& failure)
{
    // Without a slash dlopen would search the system's library folders instead.
    const std::string file = fs::absolute(binary).string();
    void* handle = dlopen(file.c_str(), RTLD_LAZY | RTLD_LOCAL);
    if (handle != nullptr)
        return handle;

    const char* reason = dlerror();
    if (IsWindowsBinary(file))
        failure = Quoted(path) + " is a Windows binary.";
    else
        failure = Quoted(path) + " could not be loaded: " + (reason == nullptr ? "unknown reason" : reason) + ".";
    return nullptr;
}

void CloseModule(void* /*handle*/)
{
    // No dlclose: many plug-ins crash when they are unmapped under their own threads and exit handlers.
}

ModuleFunction FindFunction(void* handle, const std::string& name)
{
    return reinterpret_cast<ModuleFunction>(dlsym(handle, name.c_str()));
}

} // namespace zebcore::utility::platform
