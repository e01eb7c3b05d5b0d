// Our rings and others behind the same three operations, of which every one is inlined.
#pragma once

#include "host/src/VST3/src/ParameterRing.h"
#include "utility/src/MessageRingAccess.h"

#include <boost/lockfree/queue.hpp>
#include <boost/lockfree/spsc_queue.hpp>
#include <readerwriterqueue/readerwriterqueue.h>

#include <cstddef>
#include <utility>

namespace zebaudiofilterhost::benchmarks
{

using MessagePtr = boost::intrusive_ptr<Message>;
using vst3::ParameterQueueValue;

class OurMessages
{
public:
    bool Push(const MessagePtr& message) { return mRing.Push(message); }
    bool Pop(MessagePtr& message) { return mRing.Pop(message); }

private:
    MessageRing mRing;
};

class OurChanges
{
public:
    bool Push(const ParameterQueueValue& change)
    {
        mRing.Write(change);
        return true;
    }
    bool Pop(ParameterQueueValue& change) { return mRing.Read(change, mRing.GetEnd()); }

private:
    vst3::ParameterRing mRing;
};

template <class Value, std::size_t kCapacity>
class BoostRing
{
public:
    bool Push(const Value& value) { return mQueue.push(value); }
    /// Moves out of the queue, which its pop does not.
    bool Pop(Value& value)
    {
        return mQueue.consume_one([&value](Value& place) { value = std::move(place); });
    }

private:
    boost::lockfree::spsc_queue<Value, boost::lockfree::capacity<kCapacity>> mQueue;
};

/// Takes several writers, as our ring of changes does.
template <class Value, std::size_t kCapacity>
class BoostQueue
{
public:
    bool Push(const Value& value) { return mQueue.bounded_push(value); }
    bool Pop(Value& value) { return mQueue.pop(value); }

private:
    boost::lockfree::queue<Value, boost::lockfree::capacity<kCapacity>> mQueue;
};

template <class Value, std::size_t kCapacity>
class MoodycamelRing
{
public:
    bool Push(const Value& value) { return mQueue.try_enqueue(value); }
    bool Pop(Value& value) { return mQueue.try_dequeue(value); }

private:
    moodycamel::ReaderWriterQueue<Value> mQueue{kCapacity};
};

} // namespace zebaudiofilterhost::benchmarks
