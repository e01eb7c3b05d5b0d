#include "host/src/VST3/src/ParameterRing.h"

#include "utility/src/MemoryOrder.h"

#include <bit>

namespace zebaudiofilterhost::vst3
{

namespace
{

constexpr unsigned int kTagShift = 32;

// Above 0 if the word was written under a newer ticket. Tickets are told apart by their lower halves, which is right
// as long as no writer sleeps through 2^31 changes of one parameter.
std::int32_t AgeAgainst(std::uint64_t word, std::uint64_t ticket)
{
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(word >> kTagShift) -
                                     static_cast<std::uint32_t>(ticket));
}

void PutIfNewer(std::atomic<std::uint64_t>& place, std::uint64_t ticket, std::uint32_t payload)
{
    const std::uint64_t word = ticket << kTagShift | payload;
    std::uint64_t present = place.load(std::memory_order_relaxed);
    // Release: who reads the change also sees what its writer did before. Each failure is another writer's success.
    while (AgeAgainst(present, ticket) < 0 &&
           !place.compare_exchange_weak(present, word, OrderAt(OrderSite::kParameterPut, std::memory_order_release),
                                        std::memory_order_relaxed))
    {
    }
}

} // namespace

void ParameterRing::Write(const ParameterQueueValue& value)
{
    const std::uint64_t ticket = mNextWrite.fetch_add(1, std::memory_order_relaxed);
    const auto bits = std::bit_cast<std::uint64_t>(value.mValue);
    Words& words = mPlaces[ticket % kCapacity];
    PutIfNewer(words[0], ticket, static_cast<std::uint32_t>(bits >> kTagShift));
    PutIfNewer(words[1], ticket, static_cast<std::uint32_t>(bits));
    PutIfNewer(words[2], ticket, static_cast<std::uint32_t>(value.mSampleOffset));
}

ParameterRing::Place ParameterRing::ReadPlace(std::uint64_t ticket, ParameterQueueValue& value) const
{
    const Words& words = mPlaces[ticket % kCapacity];
    std::array<std::uint64_t, 3> payloads{};
    Place place = Place::kComplete;
    for (std::size_t index = 0; index < words.size(); ++index)
    {
        // Acquire: also sees what the writer did before the change, and that the tickets have moved on.
        const std::uint64_t word = words[index].load(OrderAt(OrderSite::kParameterTake, std::memory_order_acquire));
        const std::int32_t age = AgeAgainst(word, ticket);
        if (age > 0)
            return Place::kOverwritten;
        if (age < 0)
            place = Place::kInTheMaking;
        payloads[index] = static_cast<std::uint32_t>(word);
    }
    if (place == Place::kComplete)
    {
        value.mValue = std::bit_cast<double>(payloads[0] << kTagShift | payloads[1]);
        value.mSampleOffset = static_cast<Steinberg::int32>(payloads[2]);
    }
    return place;
}

bool ParameterRing::ReadOn(ParameterQueueValue& value, std::uint64_t end)
{
    std::uint64_t ticket = OldestKept();
    while (ticket < end)
    {
        const Place place = ReadPlace(ticket, value);
        if (place == Place::kInTheMaking)
            return false;
        if (place == Place::kComplete)
        {
            mNextRead.store(ticket + 1, std::memory_order_relaxed);
            return true;
        }
        ticket = OldestKept(); // A place that was overwritten means that it has moved on by now
    }
    mNextRead.store(ticket, std::memory_order_relaxed); // Past what was discarded or overwritten
    return false;
}

void ParameterRing::Discard()
{
    const std::uint64_t end = GetEnd();
    std::uint64_t discarded = mDiscarded.load(std::memory_order_relaxed);
    while (discarded < end && !mDiscarded.compare_exchange_weak(discarded, end, std::memory_order_relaxed))
    {
    }
}

void ParameterRing::CopyTo(ParameterRing& other) const
{
    const std::uint64_t end = GetEnd();
    for (std::uint64_t ticket = OldestKept(); ticket < end; ++ticket)
    {
        ParameterQueueValue value;
        if (ReadPlace(ticket, value) == Place::kComplete)
            other.Write(value);
    }
}

} // namespace zebaudiofilterhost::vst3
