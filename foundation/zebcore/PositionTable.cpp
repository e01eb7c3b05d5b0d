#include "foundation/zebcore/internal/PositionTable.h"

#include <algorithm>
#include <stdexcept>

namespace zebcore::utility
{

namespace
{

constexpr std::size_t kFirstSize = 64;

// Beyond three quarters the rows of used slots, which every look-up has to walk, grow long.
constexpr bool IsFull(std::size_t used, std::size_t size)
{
    return used >= size - size / 4;
}

} // namespace

void PositionTable::Insert(std::size_t hash, std::size_t position)
{
    const Slot slot{Tag(hash), Narrow(position)};
    if (IsFull(mUsed, mSlots.size()))
        Grow();
    Put(slot);
    ++mUsed;
}

void PositionTable::Remove(std::size_t hash, std::size_t position)
{
    std::size_t gap = SlotOf(hash, position);
    // What comes behind moves up, unless that would take it ahead of its home, where nobody looks for it.
    for (std::size_t at = Next(gap); mSlots[at].mPosition != kFree; at = Next(at))
    {
        const std::size_t mask = mSlots.size() - 1;
        const std::size_t distanceFromHome = (at - Home(mSlots[at].mTag)) & mask;
        if (distanceFromHome >= ((at - gap) & mask))
        {
            mSlots[gap] = mSlots[at];
            gap = at;
        }
    }
    mSlots[gap] = Slot();
    --mUsed;
}

void PositionTable::Clear()
{
    mSlots.clear();
    mUsed = 0;
}

std::uint32_t PositionTable::Narrow(std::size_t position)
{
    if (position >= kFree)
        throw std::length_error("too many elements");
    return static_cast<std::uint32_t>(position);
}

std::size_t PositionTable::SlotOf(std::size_t hash, std::size_t position) const
{
    std::size_t at = Home(Tag(hash));
    while (mSlots[at].mPosition != position)
        at = Next(at);
    return at;
}

void PositionTable::Put(Slot slot)
{
    std::size_t at = Home(slot.mTag);
    while (mSlots[at].mPosition != kFree)
        at = Next(at);
    mSlots[at] = slot;
}

void PositionTable::Grow()
{
    std::vector<Slot> old(std::max(kFirstSize, 2 * mSlots.size()));
    old.swap(mSlots);
    for (const Slot& slot : old)
        if (slot.mPosition != kFree)
            Put(slot);
}

} // namespace zebcore::utility
