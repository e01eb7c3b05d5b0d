#pragma once

#include <cstddef>

namespace zebaudiofilterhost::benchmarks
{

/// How much more memory this process has used at once than it did when the object was made. It counts what is really
/// resident, whoever took it.
class PeakMemory
{
public:
    /// From now on what is freed goes back to the system at once, so that it does not count any more. Call it before
    /// all else.
    static void ReturnLargeBlocks();

    PeakMemory();

    std::size_t Bytes() const;

private:
    std::size_t mBefore;
};

} // namespace zebaudiofilterhost::benchmarks
