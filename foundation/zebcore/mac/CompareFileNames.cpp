#include "foundation/zebcore/CompareFileNames.h"

#include "foundation/zebcore/NativePath.h"

#include <CoreFoundation/CoreFoundation.h>
#include <unistd.h>

#include <functional>
#include <memory>
#include <string>
#include <type_traits>

namespace zebcore::filesupport
{

namespace
{

struct ReleaseReference
{
    void operator()(CFTypeRef reference) const { CFRelease(reference); }
};

// The volume of a path is that of the nearest directory above it that exists.
bool IsVolumeCaseSensitive(std::string path)
{
    for (;;)
    {
        const long answer = pathconf(path.c_str(), _PC_CASE_SENSITIVE);
        if (answer >= 0)
            return answer == 1;
        const std::size_t slash = path.rfind('/');
        if (slash == std::string::npos || path == "/")
            return false;
        path.resize(slash == 0 ? 1 : slash);
    }
}

enum class Case
{
    kOfVolume,
    kFolded
};

// Equal for all names of one file. Ordering by it is strict whatever mixture of volumes the paths are on.
UTF16String Key(const UTF16String& path, Case letters)
{
    const std::unique_ptr<std::remove_pointer_t<CFMutableStringRef>, ReleaseReference> text(
        CFStringCreateMutable(kCFAllocatorDefault, 0));
    CFStringAppendCharacters(text.get(), reinterpret_cast<const UniChar*>(path.data()),
                             static_cast<CFIndex>(path.size()));
    CFStringNormalize(text.get(), kCFStringNormalizationFormD);
    if (letters == Case::kFolded || !IsVolumeCaseSensitive(ToNativePath(path)))
        CFStringFold(text.get(), kCFCompareCaseInsensitive, nullptr);
    UTF16String key(static_cast<std::size_t>(CFStringGetLength(text.get())), u'\0');
    CFStringGetCharacters(text.get(), CFRangeMake(0, CFStringGetLength(text.get())),
                          reinterpret_cast<UniChar*>(key.data()));
    return key;
}

} // namespace

int CompareFileNames(const UTF16String& a, const UTF16String& b)
{
    return a == b ? 0 : Key(a, Case::kOfVolume).compare(Key(b, Case::kOfVolume));
}

// Without asking the volume: a hash is kept, and the volume may be mounted or gone when it is next asked for.
std::size_t HashFileName(const UTF16String& path)
{
    return std::hash<UTF16String>()(Key(path, Case::kFolded));
}

} // namespace zebcore::filesupport
