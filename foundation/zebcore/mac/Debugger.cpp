#include "foundation/zebcore/Contract.h"

#include <sys/sysctl.h>
#include <sys/types.h>
#include <unistd.h>

#include <cstddef>
#include <iterator>

namespace zebcore::debug
{

bool IsDebuggerAttached()
{
    kinfo_proc info{};
    std::size_t size = sizeof(info);
    int query[] = {CTL_KERN, KERN_PROC, KERN_PROC_PID, getpid()};
    const bool known = sysctl(query, static_cast<unsigned int>(std::size(query)), &info, &size, nullptr, 0) == 0;
    return known && (info.kp_proc.p_flag & P_TRACED) != 0;
}

} // namespace zebcore::debug
