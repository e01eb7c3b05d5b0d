#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace zebcore::utility
{

// Finds the elements of a sequence by the hashes of their keys, without the keys: it knows hashes and positions only,
// side by side, so that a look-up in a large sequence touches one line of the processor's cache and then the element.
class PositionTable
{
public:
    static constexpr std::size_t kNone = static_cast<std::size_t>(-1);

    // The position that was inserted under the hash and for which `isIt` returns true; kNone if there is none.
    template <typename Predicate>
    std::size_t Find(std::size_t hash, Predicate isIt) const
    {
        if (mUsed == 0)
            return kNone;
        const std::uint32_t tag = Tag(hash);
        for (std::size_t at = Home(tag); mSlots[at].mPosition != kFree; at = Next(at))
            if (mSlots[at].mTag == tag && isIt(std::size_t{mSlots[at].mPosition}))
                return mSlots[at].mPosition;
        return kNone;
    }

    // Throws std::length_error for a position beyond 2^32 - 2, std::bad_alloc; the table is as before then.
    void Insert(std::size_t hash, std::size_t position);

    // The position must have been inserted under the hash.
    void Remove(std::size_t hash, std::size_t position);

    void Clear();

    bool IsEmpty() const { return mUsed == 0; }

private:
    static constexpr std::uint32_t kFree = static_cast<std::uint32_t>(-1);

    struct Slot
    {
        std::uint32_t mTag = 0;
        std::uint32_t mPosition = kFree;
    };

    static std::uint32_t Tag(std::size_t hash) { return static_cast<std::uint32_t>(hash ^ (hash >> 32U)); }
    static std::uint32_t Narrow(std::size_t position);

    std::size_t Home(std::uint32_t tag) const { return tag & (mSlots.size() - 1); }
    std::size_t Next(std::size_t at) const { return (at + 1) & (mSlots.size() - 1); }
    std::size_t SlotOf(std::size_t hash, std::size_t position) const;
    void Put(Slot slot);
    void Grow();

    std::vector<Slot> mSlots; // a power of two of them, or none; always some are free
    std::size_t mUsed = 0;
};

} // namespace zebcore::utility
