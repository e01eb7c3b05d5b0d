#include "foundation/zebcore/internal/PlatformFiles.h"

#include "foundation/zebcore/NativePath.h"

#include <CoreFoundation/CoreFoundation.h>
#include <fcntl.h>
#include <pwd.h>
#include <unistd.h>

#include <cstdlib>
#include <memory>
#include <string>
#include <type_traits>
#include <vector>

namespace zebcore::filesupport
{

namespace
{

constexpr const char* kRoot = "/";

struct ReleaseReference
{
    void operator()(CFTypeRef reference) const { CFRelease(reference); }
};

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
    // fsync leaves the data in the drive's own cache. Volumes that know no full flush still know fsync.
    return fcntl(descriptor, F_FULLFSYNC) == 0 ? 0 : fsync(descriptor);
}

UTF16String ApplicationDirectory()
{
    CFBundleRef const bundle = CFBundleGetMainBundle();
    const std::unique_ptr<std::remove_pointer_t<CFURLRef>, ReleaseReference> url(
        bundle == nullptr ? nullptr : CFBundleCopyBundleURL(bundle));
    std::vector<UInt8> path(4096);
    if (!url || !CFURLGetFileSystemRepresentation(url.get(), true, path.data(), static_cast<CFIndex>(path.size())))
        return FromNativePath(kRoot);
    return FromNativePath(reinterpret_cast<const char*>(path.data()));
}

UTF16String UserPreferenceDirectory()
{
    return FromNativePath(HomeDirectory() + "/Library/Preferences");
}

} // namespace zebcore::filesupport
