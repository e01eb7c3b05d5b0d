#pragma once

#include "utility/Message.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <array>
#include <atomic>
#include <cstddef>

namespace zebaudiofilterhost
{

/// Messages on their way from one thread to one other, in the order of pushing. Nobody waits, nothing is allocated,
/// and nothing is freed as long as somebody else refers to what is in here. Only the library's own sources push and
/// pop.
class MessageRing
{
public:
    /// False, with nothing stored, when the ring is full. The message must not be null. [main]
    bool Push(const boost::intrusive_ptr<Message>& message);

    /// Moves the oldest message to `message`. False, with nothing written, when there is none. [process]
    bool Pop(boost::intrusive_ptr<Message>& message);

private:
    static constexpr std::size_t kSize = 33; // One place stays free, which tells a full ring from an empty one
    static constexpr std::size_t kCacheLine = 64;

    static std::size_t Next(std::size_t index) { return index + 1 == kSize ? 0 : index + 1; }

    alignas(kCacheLine) std::atomic<std::size_t> mWriteIndex{0}; // Written by the producer only
    alignas(kCacheLine) std::atomic<std::size_t> mReadIndex{0};  // Written by the consumer only
    std::array<boost::intrusive_ptr<Message>, kSize> mPlaces;
};

} // namespace zebaudiofilterhost
