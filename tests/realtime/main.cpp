// Starts itself once more with everything to be bound at load, plug-ins too, as a program with a process thread is to
// be started: a function that is bound at its first call would be bound in a block.
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <malloc.h>
#include <unistd.h>

int main(int argc, char** argv)
{
    if (std::getenv("LD_BIND_NOW") == nullptr)
    {
        setenv("LD_BIND_NOW", "1", 1);
        execv("/proc/self/exe", argv);
    }
    constexpr int kPage = 4096;
    mallopt(M_MMAP_THRESHOLD, kPage);
    zebaudiofilterhost::InitializeMainThreadID(); // ahead of the first filter, which listens on this thread's loop
    testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
