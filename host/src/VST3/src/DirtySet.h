#pragma once

#include "utility/src/MemoryOrder.h"

#include <atomic>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// A set of numbers that any thread adds to and one takes from, in ascending order, at a cost that follows what is in
/// it and not how large it could be. A tree of words of 64 bits: a bit says that there may be something in the word
/// below it. Whoever adds sets bits upward from the leaf; who takes all clears them downward; who removes one clears
/// them upward and puts back what was filled below meanwhile: so a bit over an empty word can stay behind, and a
/// number is never lost. No lock, no allocation after construction.
class DirtySet
{
public:
    /// Numbers below `size`.
    explicit DirtySet(std::size_t size);

    /// [any]
    void Add(std::size_t number);

    /// Takes one number out, unless it is added at the same time. Others can be out of sight meanwhile. After that
    /// the caller sees what came before the additions that were undone. [any]
    void Remove(std::size_t number);

    /// False means empty. [any]
    bool MayHaveAny() const { return TopWord().load(std::memory_order_relaxed) != 0; }

    /// Takes out all numbers and calls `visit` with each. One thread at a time.
    template <class Visit>
    void TakeAll(const Visit& visit)
    {
        if (MayHaveAny())
            TakeWord(mLevels.size() - 1, 0, visit);
    }

private:
    using Word = std::atomic<std::uint64_t>;

    static constexpr std::size_t kBits = 64;

    static std::uint64_t BitOf(std::size_t number) { return std::uint64_t(1) << (number % kBits); }

    const Word& TopWord() const { return mLevels.back().front(); }
    void AddAbove(std::size_t level, std::size_t number);

    template <class Visit>
    void TakeWord(std::size_t level, std::size_t index, const Visit& visit)
    {
        // Acquire: after a bit is seen, so is everything that its setter did before, in the words below too.
        std::uint64_t bits =
            mLevels[level][index].exchange(0, OrderAt(OrderSite::kDirtySetTake, std::memory_order_acquire));
        for (; bits != 0; bits &= bits - 1)
        {
            const std::size_t number = index * kBits + static_cast<std::size_t>(std::countr_zero(bits));
            if (level == 0)
                visit(number);
            else
                TakeWord(level - 1, number, visit);
        }
    }

    std::vector<std::vector<Word>> mLevels; // leaves first; the last one is a single word
};

} // namespace zebaudiofilterhost::vst3
