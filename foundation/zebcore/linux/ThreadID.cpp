#include "foundation/zebcore/Threads.h"

#include <unistd.h>

namespace zebcore::threads
{

ThreadID GetCurrentThreadID() noexcept
{
    static thread_local ThreadID sThreadID = 0;
    if (sThreadID == 0)
        sThreadID = static_cast<ThreadID>(gettid());
    return sThreadID;
}

} // namespace zebcore::threads
