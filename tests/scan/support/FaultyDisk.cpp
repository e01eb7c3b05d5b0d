// A disk that fails: the program's own calls of the system in place of the C library's, so that all of its libraries
// use them. ZEB_FAULT holds a call, what is to become of it, and a part of the names of the files that it is to
// happen to, separated by colons: "write:full:Settings.xml", "write:short:...", "sync:broken:...",
// "rename:refused:...". The name's end alone counts behind a '$'; a number and a '+' in front of the name let so many
// calls go well before.
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <vector>

#include <dlfcn.h>
#include <unistd.h>

namespace
{

struct Fault
{
    std::string call;
    std::string what;
    std::string file;
};

Fault TheFault()
{
    const char* text = std::getenv("ZEB_FAULT");
    const std::string fault = text == nullptr ? "::" : text;
    const std::size_t first = fault.find(':');
    const std::size_t second = fault.find(':', first + 1);
    return {fault.substr(0, first), fault.substr(first + 1, second - first - 1), fault.substr(second + 1)};
}

bool IsMeant(const std::string& file, const std::string& name)
{
    return name.rfind('$', 0) == 0 ? file.size() >= name.size() - 1 && file.ends_with(name.substr(1))
                                   : file.find(name) != std::string::npos;
}

// Empty unless the call is to fail on this file.
std::string FaultOf(const std::string& call, const std::string& file)
{
    const Fault fault = TheFault();
    if (fault.call != call || !IsMeant(file, fault.file.substr(fault.file.find('+') + 1)))
    {
        return "";
    }
    static int sCalls = 0;
    const bool hasCount = fault.file.find('+') != std::string::npos;
    return hasCount && sCalls++ < std::stoi(fault.file) ? "" : fault.what;
}

std::string PathOf(int descriptor)
{
    std::string path(4096, '\0');
    const ssize_t size = readlink(("/proc/self/fd/" + std::to_string(descriptor)).c_str(), path.data(), path.size());
    return path.substr(0, size < 0 ? 0 : static_cast<std::size_t>(size));
}

int Fail(const std::string& fault)
{
    errno = fault == "full" ? ENOSPC : fault == "refused" ? EPERM : EIO;
    return -1;
}

template <typename Function>
Function* Real(const char* name)
{
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

} // namespace

extern "C"
{
    __attribute__((visibility("default"))) ssize_t write(int descriptor, const void* data, std::size_t size)
    {
        static auto* const sReal = Real<ssize_t(int, const void*, std::size_t)>("write");
        const std::string fault = FaultOf("write", PathOf(descriptor));
        if (fault.empty())
        {
            return sReal(descriptor, data, size);
        }
        static int sCalls = 0;
        const bool isShort = fault == "short" || (fault == "shortThenFull" && sCalls++ % 2 == 0);
        return isShort ? sReal(descriptor, data, size > 7 ? 7 : size) : Fail("full");
    }

    __attribute__((visibility("default"))) int fsync(int descriptor)
    {
        static auto* const sReal = Real<int(int)>("fsync");
        const std::string fault = FaultOf("sync", PathOf(descriptor));
        return fault.empty() ? sReal(descriptor) : Fail(fault);
    }

    __attribute__((visibility("default"))) int rename(const char* from, const char* to) noexcept
    {
        static auto* const sReal = Real<int(const char*, const char*)>("rename");
        const std::string fault = FaultOf("rename", to);
        return fault.empty() ? sReal(from, to) : Fail(fault);
    }
}
