#pragma once

#include <cstddef>

namespace zebaudiofilterhost::benchmarks
{

/// How much more memory this process has used at once than it did when the object was made. It counts what is really
/// resident, whoever took it.
class PeakMemory
{
public:
    PeakMemory();

    std::size_t Bytes() const;

private:
    std::size_t mBefore;
};

} // namespace zebaudiofilterhost::benchmarks
