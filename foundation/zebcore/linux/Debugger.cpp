#include "foundation/zebcore/Contract.h"

#include <fstream>
#include <string>
#include <string_view>

namespace zebcore::debug
{

bool IsDebuggerAttached()
{
    constexpr std::string_view kTracer = "TracerPid:";

    std::ifstream status("/proc/self/status");
    std::string line;
    while (std::getline(status, line))
    {
        if (line.starts_with(kTracer))
            return line.find_first_of("123456789", kTracer.size()) != std::string::npos;
    }
    return false;
}

} // namespace zebcore::debug
