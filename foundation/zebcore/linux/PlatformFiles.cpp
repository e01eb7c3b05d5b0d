#include "foundation/zebcore/internal/PlatformFiles.h"

#include "foundation/zebcore/NativePath.h"

#include <pwd.h>
#include <unistd.h>

#include <cstdlib>
#include <string>
#include <vector>

namespace zebcore::filesupport
{

namespace
{

constexpr const char* kRoot = "/";

std::string HomeDirectory()
{
    if (const char* const home = std::getenv("HOME"); home != nullptr && *home == '/')
        return home;
    std::vector<char> buffer(16384);
    passwd entry{};
    passwd* found = nullptr;
    getpwuid_r(getuid(), &entry, buffer.data(), buffer.size(), &found);
    return found == nullptr ? kRoot : found->pw_dir;
}

} // namespace

int FlushToDisk(int descriptor)
{
    return fsync(descriptor);
}

UTF16String ApplicationDirectory()
{
    std::vector<char> buffer(4096);
    ssize_t length = 0;
    while ((length = readlink("/proc/self/exe", buffer.data(), buffer.size())) == static_cast<ssize_t>(buffer.size()))
        buffer.resize(2 * buffer.size());
    const std::string executable(buffer.data(), length > 0 ? static_cast<std::size_t>(length) : 0);
    const std::size_t slash = executable.rfind('/');
    return FromNativePath(slash == std::string::npos || slash == 0 ? kRoot : executable.substr(0, slash));
}

UTF16String UserPreferenceDirectory()
{
    // A relative path in the variable is to be ignored, by the rules of the desktop's base directories.
    const char* const config = std::getenv("XDG_CONFIG_HOME");
    const std::string base = config != nullptr && *config == '/' ? config : HomeDirectory() + "/.config";
    return FromNativePath(base + "/zebaudiofilterhost");
}

} // namespace zebcore::filesupport
