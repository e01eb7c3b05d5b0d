// Both ends of the ring, apart from its class, since the memory orders are no business of who includes that.
#pragma once

#include "utility/MessageRing.h"
#include "utility/src/MemoryOrder.h"

#include <utility>

namespace zebaudiofilterhost
{

inline bool MessageRing::Push(const boost::intrusive_ptr<Message>& message)
{
    const std::size_t write = mWriteIndex.load(std::memory_order_relaxed); // Our own
    const std::size_t next = Next(write);
    // Acquire: the consumer has emptied the place before it moved the read index on.
    if (next == mReadIndex.load(OrderAt(OrderSite::kMessagePushLooks, std::memory_order_acquire)))
        return false;
    mPlaces[write] = message;
    // Release: publishes the place.
    mWriteIndex.store(next, OrderAt(OrderSite::kMessagePushPublishes, std::memory_order_release));
    return true;
}

inline bool MessageRing::Pop(boost::intrusive_ptr<Message>& message)
{
    const std::size_t read = mReadIndex.load(std::memory_order_relaxed); // Our own
    // Acquire: sees the place that the producer filled before it published the index.
    if (read == mWriteIndex.load(OrderAt(OrderSite::kMessagePopLooks, std::memory_order_acquire)))
        return false;
    message = std::move(mPlaces[read]);
    // Release: gives the empty place back.
    mReadIndex.store(Next(read), OrderAt(OrderSite::kMessagePopGivesBack, std::memory_order_release));
    return true;
}

} // namespace zebaudiofilterhost
