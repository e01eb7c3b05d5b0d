#include "foundation/zebcore/Threads.h"

#include <pthread.h>

#include <cstdint>

namespace zebcore::threads
{

ThreadID GetCurrentThreadID() noexcept
{
    static thread_local ThreadID sThreadID = 0;
    if (sThreadID == 0)
    {
        std::uint64_t id = 0;
        pthread_threadid_np(nullptr, &id);
        sThreadID = id;
    }
    return sThreadID;
}

} // namespace zebcore::threads
