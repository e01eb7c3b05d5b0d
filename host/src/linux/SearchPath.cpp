#include "host/src/linux/SearchPath.h"

#include "foundation/zebcore/NativePath.h"

#include <cstdlib>
#include <filesystem>
#include <string>
#include <system_error>

namespace zebaudiofilterhost
{

namespace
{

constexpr std::string_view kHomePrefix = "~/";

// Absolute, since what is found goes into a catalogue that outlives this process.
Dir MakeDir(std::string_view path)
{
    std::error_code error;
    const std::filesystem::path absolute = std::filesystem::absolute(path, error);
    return Dir(zebcore::filesupport::FromNativePath(error ? std::string(path) : absolute.native()));
}

// Empty if the variable is not set.
std::string_view GetVariable(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : std::string_view();
}

std::vector<Dir> SplitPath(std::string_view path)
{
    std::vector<Dir> places;
    while (!path.empty())
    {
        const std::size_t end = path.find(':');
        if (end != 0)
            places.push_back(MakeDir(path.substr(0, end)));
        path.remove_prefix(end == std::string_view::npos ? path.size() : end + 1);
    }
    return places;
}

} // namespace

std::vector<Dir> GetSearchPath(const char* variable, std::initializer_list<std::string_view> standard)
{
    if (const std::string_view path = GetVariable(variable); !path.empty())
        return SplitPath(path);
    const std::string home(GetVariable("HOME"));
    std::vector<Dir> places;
    for (const std::string_view place : standard)
    {
        if (!place.starts_with(kHomePrefix))
            places.push_back(MakeDir(place));
        else if (!home.empty())
            places.push_back(MakeDir(home + "/" + std::string(place.substr(kHomePrefix.size()))));
    }
    return places;
}

} // namespace zebaudiofilterhost
