#include "foundation/zebcore/internal/OSModulePlatform.h"

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/mac/MACtoZEB.h"

#include <CoreFoundation/CoreFoundation.h>

#include <array>

namespace zebcore::utility::platform
{

namespace
{

CFBundleRef CreateBundle(const std::string& path)
{
    const auto* bytes = reinterpret_cast<const UInt8*>(path.data());
    const CFURLRef url =
        CFURLCreateFromFileSystemRepresentation(kCFAllocatorDefault, bytes, static_cast<CFIndex>(path.size()), false);
    const CFBundleRef bundle = url == nullptr ? nullptr : CFBundleCreate(kCFAllocatorDefault, url);
    if (url != nullptr)
        CFRelease(url);
    return bundle;
}

std::string ExecutablePath(CFBundleRef bundle)
{
    const CFURLRef url = CFBundleCopyExecutableURL(bundle);
    if (url == nullptr)
        return {};
    std::array<UInt8, 4096> path{};
    const bool isKnown = CFURLGetFileSystemRepresentation(url, true, path.data(), static_cast<CFIndex>(path.size()));
    const std::string result = isKnown ? reinterpret_cast<const char*>(path.data()) : "";
    CFRelease(url);
    return result;
}

/// In the words of the system, a sentence.
std::string TakeDescription(CFErrorRef error)
{
    const CFStringRef description = error == nullptr ? nullptr : CFErrorCopyDescription(error);
    if (error != nullptr)
        CFRelease(error);
    if (description == nullptr)
        return "unknown reason.";
    const std::string text = filesupport::ToNativePath(MACtoZEB(description));
    CFRelease(description);
    return text;
}

} // namespace

std::string FindBinary(const std::string& path, std::string& failure)
{
    const CFBundleRef bundle = CreateBundle(path);
    if (bundle == nullptr)
    {
        failure = "\"" + path + "\" does not exist, or is not a plug-in bundle.";
        return {};
    }
    const std::string binary = ExecutablePath(bundle);
    CFRelease(bundle);
    if (binary.empty())
        failure = "\"" + path + "\" holds no binary for this system.";
    return binary;
}

void* OpenModule(const std::string& path, const std::string& /*binary*/, std::string& failure)
{
    const CFBundleRef bundle = CreateBundle(path);
    if (bundle == nullptr)
    {
        failure = "\"" + path + "\" is not a plug-in bundle.";
        return nullptr;
    }
    // The code itself is loaded when the first function is looked up, where a failure has no words.
    CFErrorRef error = nullptr;
    if (CFBundlePreflightExecutable(bundle, &error))
        return bundle;
    failure = "\"" + path + "\" could not be loaded: " + TakeDescription(error);
    CFRelease(bundle);
    return nullptr;
}

void CloseModule(void* handle)
{
    CFRelease(handle);
}

ModuleFunction FindFunction(void* handle, const std::string& name)
{
    const CFStringRef symbol = CFStringCreateWithCString(kCFAllocatorDefault, name.c_str(), kCFStringEncodingUTF8);
    if (symbol == nullptr)
        return nullptr;
    void* function = CFBundleGetFunctionPointerForName(static_cast<CFBundleRef>(handle), symbol);
    CFRelease(symbol);
    return reinterpret_cast<ModuleFunction>(function);
}

} // namespace zebcore::utility::platform
