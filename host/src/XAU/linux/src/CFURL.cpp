#include "CoreFoundation/CFURL.h"

#include "host/src/XAU/linux/src/CFObject.h"

#include <cstring>
#include <filesystem>
#include <functional>
#include <string>
#include <system_error>

using namespace zebaudiofilterhost::xau;

struct CFOpaqueURL final : cf::Object
{
    explicit CFOpaqueURL(std::string path) : Object(cf::TypeID::URL), mPath(std::move(path)) {}

    bool Equals(const Object& other) const override { return mPath == static_cast<const CFOpaqueURL&>(other).mPath; }
    CFHashCode Hash() const override { return std::hash<std::string>()(mPath); }

    const std::string mPath;
};

CFTypeID CFURLGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::URL);
}

CFURLRef CFURLCreateFromFileSystemRepresentation(CFAllocatorRef /*allocator*/, const UInt8* path, CFIndex count,
                                                 Boolean /*isDirectory*/)
{
    if (!path || count <= 0)
        return nullptr;
    return new CFOpaqueURL(std::string(reinterpret_cast<const char*>(path), static_cast<std::size_t>(count)));
}

Boolean CFURLGetFileSystemRepresentation(CFURLRef url, Boolean resolveAgainstBase, UInt8* path, CFIndex size)
{
    std::string native = url->mPath;
    if (resolveAgainstBase != 0)
    {
        std::error_code failure;
        native = std::filesystem::absolute(native, failure).string();
        if (failure)
            return 0;
    }
    if (size < 0 || native.size() >= static_cast<std::size_t>(size))
        return 0;
    std::memcpy(path, native.c_str(), native.size() + 1);
    return 1;
}
