#include "foundation/zebcore/SmallBlockAllocator.h"

namespace zebcore::utility
{

void* SmallBlockAllocator::Allocate(std::size_t size)
{
    return ::operator new(size);
}

void SmallBlockAllocator::Dispose(void* block, std::size_t /*size*/) noexcept
{
    ::operator delete(block);
}

} // namespace zebcore::utility
