#pragma once

#include "host/src/VST3/src/ParameterQueueValue.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>

namespace zebaudiofilterhost::vst3
{

/// The newest kMaxPointsPerParameter changes of one parameter. Any number of writers, one reader at a time, who may
/// change. No lock, no allocation, and nobody waits for anybody. [any]
//
/// A writer takes a ticket, which fixes the place and the order, and then puts three words into the place, each of
/// which holds a third of the change and the ticket. A word is only replaced by one with a newer ticket, so a writer
/// that was held up for a whole round finds newer words and loses its change, which was the oldest anyway. A reader
/// takes a place whose three words bear the ticket that it expects; older words mean that the writer is still at
/// work, and the reader comes back later; newer ones mean that the change was overwritten.
class ParameterRing
{
public:
    void Write(const ParameterQueueValue& value);

    /// The ticket that the next writer gets: what Read takes as its limit, so that busy writers cannot keep it for
    /// ever.
    std::uint64_t GetEnd() const { return mNextWrite.load(std::memory_order_relaxed); }

    /// Takes the oldest change out, if it was written before `end`. False, with nothing written, if there is none.
    /// The reader's.
    bool Read(ParameterQueueValue& value, std::uint64_t end)
    {
        return end != mNextRead.load(std::memory_order_relaxed) && ReadOn(value, end);
    }

    /// Changes in the making count.
    bool IsEmpty() const { return GetNextRead() >= GetEnd(); }

    /// Drops what is pending. A change that is being read meanwhile can still be read.
    void Discard();

    /// Writes what is pending here to `other`, and leaves it here.
    void CopyTo(ParameterRing& other) const;

private:
    enum class Place
    {
        kComplete,
        kInTheMaking,
        kOverwritten
    };

    static constexpr std::uint64_t kCapacity = kMaxPointsPerParameter;

    using Words = std::array<std::atomic<std::uint64_t>, 3>;

    Place ReadPlace(std::uint64_t ticket, ParameterQueueValue& value) const;
    bool ReadOn(ParameterQueueValue& value, std::uint64_t end);

    std::uint64_t GetNextRead() const
    {
        return std::max(mNextRead.load(std::memory_order_relaxed), mDiscarded.load(std::memory_order_relaxed));
    }
    std::uint64_t OldestKept() const { return std::max(GetNextRead(), GetEnd() - kCapacity); }

    /// Tickets begin after the first round, so that the zeros of a place that was never written count as older.
    /// Tickets alone say nothing of what is in a place, hence need no order: the words tell.
    std::atomic<std::uint64_t> mNextWrite{kCapacity};
    std::atomic<std::uint64_t> mNextRead{kCapacity};  // written by the reader only
    std::atomic<std::uint64_t> mDiscarded{kCapacity}; // tickets below it are not read any more
    std::array<Words, kCapacity> mPlaces{};
};

} // namespace zebaudiofilterhost::vst3
