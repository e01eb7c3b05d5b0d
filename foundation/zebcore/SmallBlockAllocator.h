#pragma once

#include "foundation/zebcore/Export.h"

#include <cstddef>
#include <limits>
#include <new>

namespace zebcore::utility
{

/// Allocator whose caller keeps the size of each block. It maps to the global one, which serves small blocks as fast
/// as a pool of our own would.
class ZEB_EXPORT SmallBlockAllocator
{
public:
    /// Never null; throws std::bad_alloc. [any but process]
    static void* Allocate(std::size_t size);
    /// size: as it was given to Allocate. A null pointer is fine. [any but process]
    static void Dispose(void* block, std::size_t size) noexcept;

    /// For the standard's containers.
    template <class T>
    class STLAllocator
    {
    public:
        using value_type = T;

        STLAllocator() = default;
        template <class U>
        STLAllocator(const STLAllocator<U>& /*all are alike*/) noexcept
        {
        }

        T* allocate(std::size_t count)
        {
            if (count > std::numeric_limits<std::size_t>::max() / sizeof(T))
                throw std::bad_array_new_length();
            return static_cast<T*>(Allocate(count * sizeof(T)));
        }
        void deallocate(T* block, std::size_t count) noexcept { Dispose(block, count * sizeof(T)); }

        template <class U>
        bool operator==(const STLAllocator<U>& /*all are alike*/) const noexcept
        {
            return true;
        }
    };
};

} // namespace zebcore::utility
