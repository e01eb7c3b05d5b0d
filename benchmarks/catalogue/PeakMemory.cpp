#include "benchmarks/catalogue/PeakMemory.h"

#include <malloc.h>

#include <fstream>
#include <stdexcept>
#include <string>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

// A line of /proc/self/status, which is in kilobytes.
std::size_t Status(const std::string& name)
{
    std::ifstream status("/proc/self/status");
    for (std::string word; status >> word;)
    {
        std::size_t kilobytes = 0;
        if (word == name + ":" && status >> kilobytes)
            return kilobytes * 1024;
    }
    throw std::runtime_error("the kernel does not tell " + name);
}

} // namespace

void PeakMemory::ReturnLargeBlocks()
{
    constexpr int kLargeBlock = 1 << 20;
    mallopt(M_MMAP_THRESHOLD, kLargeBlock);
}

PeakMemory::PeakMemory()
{
    malloc_trim(0);
    std::ofstream("/proc/self/clear_refs") << "5"; // The peak begins anew
    mBefore = Status("VmRSS");
}

std::size_t PeakMemory::Bytes() const
{
    const std::size_t peak = Status("VmHWM");
    return peak > mBefore ? peak - mBefore : 0;
}

} // namespace zebaudiofilterhost::benchmarks
