#include "Resources.h"

#include <filesystem>
#include <fstream>

#include <malloc.h>
#include <unistd.h>

namespace soak
{

namespace
{

std::size_t ResidentBytes()
{
    std::ifstream statm("/proc/self/statm");
    std::size_t total = 0;
    std::size_t resident = 0;
    statm >> total >> resident;
    return resident * static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
}

int CountEntries(const char* folder)
{
    int count = 0;
    for ([[maybe_unused]] const auto& entry : std::filesystem::directory_iterator(folder))
    {
        ++count;
    }
    return count;
}

} // namespace

std::size_t HeapInUse()
{
    const auto info = mallinfo2();
    return info.uordblks + info.hblkhd;
}

Resources MeasureResources()
{
    malloc_trim(0);
    // The descriptor that reads the folder is one of those that are counted, each time.
    return {ResidentBytes(), HeapInUse(), CountEntries("/proc/self/fd"), CountEntries("/proc/self/task")};
}

} // namespace soak
