#include "host/src/VST3/src/VST3Places.h"

#include "foundation/zebcore/NativePath.h"

#include <cstdlib>
#include <string>
#include <string_view>

namespace zebaudiofilterhost::vst3
{

namespace
{

Dir MakeDir(std::string_view path)
{
    return Dir(zebcore::filesupport::FromNativePath(path));
}

// Null if the variable is not there or empty.
const char* GetVariable(const char* name)
{
    const char* value = std::getenv(name);
    return value && *value != '\0' ? value : nullptr;
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

std::vector<Dir> GetVST3Places()
{
    if (const char* path = GetVariable("VST3_PATH"))
        return SplitPath(path);
    std::vector<Dir> places;
    if (const char* home = GetVariable("HOME"))
        places.push_back(MakeDir(std::string(home) + "/.vst3"));
    places.push_back(MakeDir("/usr/local/lib/vst3"));
    places.push_back(MakeDir("/usr/lib/vst3"));
    return places;
}

} // namespace zebaudiofilterhost::vst3
