#include "foundation/zebcore/OSModule.h"

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/internal/OSModulePlatform.h"

#include <memory>
#include <stdexcept>

namespace zebcore::utility
{

struct OSModule
{
    void* mHandle;
    UTF16String mBinaryPath;
};

namespace
{

std::string& LastFailure()
{
    static std::string& failure = *new std::string;
    return failure;
}

void SetLastFailure(const UTF16String& path, const char* reason)
{
    LastFailure() = "\"" + filesupport::ToNativePath(path) + "\" could not be loaded: " + reason + ".";
}

std::string NativePath(const UTF16String& path)
{
    // The system would stop at a zero unit, and load a file of another name.
    if (path.find(u'\0') != UTF16String::npos)
        throw std::invalid_argument("its path holds a zero unit");
    return filesupport::ToNativePath(path);
}

/// Runs a step that works with the platform. Nothing it throws gets out, what a plug-in's initializers throw
/// included.
template <class Step>
auto WithoutThrowing(const UTF16String& path, Step step) noexcept -> decltype(step())
{
    try
    {
        return step();
    }
    catch (const std::exception& exception)
    {
        SetLastFailure(path, exception.what());
    }
    catch (...)
    {
        SetLastFailure(path, "it threw an exception");
    }
    return {};
}

} // namespace

OSModuleRef LoadOSModule(const UTF16String& path) noexcept
{
    return WithoutThrowing(
        path,
        [&]() -> OSModuleRef
        {
            const std::string nativePath = NativePath(path);
            const std::string binary = platform::FindBinary(nativePath, LastFailure());
            if (binary.empty())
                return nullptr;
            void* handle = platform::OpenModule(nativePath, binary, LastFailure());
            if (handle == nullptr)
                return nullptr;
            return std::make_unique<OSModule>(OSModule{handle, filesupport::FromNativePath(binary)}).release();
        });
}

void ReleaseOSModule(OSModuleRef module) noexcept
{
    if (module == nullptr)
        return;
    platform::CloseModule(module->mHandle);
    delete module;
}

UTF16String FindOSModuleBinary(const UTF16String& path) noexcept
{
    return WithoutThrowing(
        path, [&] { return filesupport::FromNativePath(platform::FindBinary(NativePath(path), LastFailure())); });
}

UTF16String GetLastOSModuleError()
{
    return filesupport::FromNativePath(LastFailure());
}

void* GetOSModuleHandle(OSModuleRef module) noexcept
{
    return module == nullptr ? nullptr : module->mHandle;
}

UTF16String GetOSModuleBinaryPath(OSModuleRef module)
{
    return module == nullptr ? UTF16String() : module->mBinaryPath;
}

ModuleFunction GetFunctionPointerFromModuleImpl(OSModuleRef module, const std::string& name) noexcept
{
    return module == nullptr ? nullptr : platform::FindFunction(module->mHandle, name);
}

} // namespace zebcore::utility
