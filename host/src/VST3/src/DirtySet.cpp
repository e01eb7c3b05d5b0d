#include "host/src/VST3/src/DirtySet.h"

namespace zebaudiofilterhost::vst3
{

DirtySet::DirtySet(std::size_t size)
{
    // Never fewer than two levels, so that small sets cost what those of 4096 cost.
    do
    {
        size = (size + kBits - 1) / kBits;
        mLevels.emplace_back(size == 0 ? 1 : size);
    } while (mLevels.size() < 2 || mLevels.back().size() > 1);
}

void DirtySet::Add(std::size_t number)
{
    AddAbove(0, number);
}

void DirtySet::AddAbove(std::size_t level, std::size_t number)
{
    // Release at every level: the bit above is not seen before the bit below, nor before what the caller wrote.
    for (; level < mLevels.size(); ++level, number /= kBits)
        mLevels[level][number / kBits].fetch_or(BitOf(number),
                                                OrderAt(OrderSite::kDirtySetAdd, std::memory_order_release));
}

void DirtySet::Remove(std::size_t number)
{
    for (std::size_t level = 0; level < mLevels.size(); ++level, number /= kBits)
    {
        const std::uint64_t bit = BitOf(number);
        // Acquire: with a bit, everything that its setter did before, in the word below too.
        const std::uint64_t others = mLevels[level][number / kBits].fetch_and(
                                         ~bit, OrderAt(OrderSite::kDirtySetRemove, std::memory_order_acquire)) &
                                     ~bit;
        // Asked ahead of the others: whoever added below saw the bit still set, or sets it again.
        const bool addedMeanwhile = level > 0 && mLevels[level - 1][number].load(std::memory_order_relaxed) != 0;
        if (addedMeanwhile)
        {
            AddAbove(level, number);
            return;
        }
        if (others != 0)
            return;
    }
}

} // namespace zebaudiofilterhost::vst3
