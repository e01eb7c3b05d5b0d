#pragma once

#include <cstddef>

namespace soak
{

/// What the process holds at one moment.
struct Resources
{
    std::size_t resident = 0; // bytes in memory
    std::size_t inUse = 0;    // bytes that were allocated and not freed
    int descriptors = 0;
    int threads = 0;
};

/// Gives back to the system what the allocator holds in reserve, and measures then. [main]
Resources MeasureResources();

/// Bytes that were allocated and not freed, by anyone in the process. [main]
std::size_t HeapInUse();

} // namespace soak
