// The lock-free road of messages from the main thread to the process thread.
#pragma once

#include "foundation/zebcore/Export.h"
#include "utility/Message.h"
#include "utility/MessageRing.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <atomic>
#include <cstddef>
#include <vector>

namespace zebaudiofilterhost
{

/// Carries messages to the process thread through a ring of fixed size and keeps them alive on the main thread.
///
/// Nobody waits: a full ring leaves a message pending until a later Post or PumpFromMainThread. Messages run in the
/// order of posting. While no process thread consumes (SetProcessing), the main thread is the consumer.
class ZEB_EXPORT ProcessMessageHandler
{
public:
    ProcessMessageHandler();

    ProcessMessageHandler(const ProcessMessageHandler&) = delete;
    ProcessMessageHandler& operator=(const ProcessMessageHandler&) = delete;

    /// Runs what waits: on the main thread PumpFromMainThread, elsewhere PumpFromProcessThread.
    /// [main], or the process thread
    virtual void FlushMessageQueue();

    virtual ~ProcessMessageHandler();

    /// Queues a message, which must not be null and must not be in the queue already. Passes on what an allocation
    /// throws. [main]
    void Post(boost::intrusive_ptr<Message> message);

    /// Runs the process stage of what is in the ring. Takes no lock, allocates and frees nothing. [process]
    void PumpFromProcessThread();

    /// Fills the ring, runs it here if no process thread does, runs main stages and drops what is finished. The last
    /// release of a message may destroy the owner of this handler, so a caller holds a reference to the owner, or
    /// touches nothing of it afterwards. [main]
    void PumpFromMainThread();

    /// Says whether a process thread consumes the ring. Give false only after it has stopped. [main]
    void SetProcessing(bool processing);

protected:
    /// Moves pending messages into the ring, in order, as far as there is room. [main]
    void TransferMessagesToQueue();

    /// Drops finished messages that nobody else refers to; the others stay for a later purge. [main]
    void PurgeProcessedMessages();

    /// Whether PurgeProcessedMessages has marked the message. [main]
    static bool CanDeleteMessage(boost::intrusive_ptr<Message> message);

private:
    using MessageList = std::vector<boost::intrusive_ptr<Message>>;

    void RunMainStages();

    MessageRing mRing;
    MessageList mMessages;        // All living messages, in order of posting; main thread only
    std::size_t mFirstToLook = 0; // No message ahead of it is pending; main thread only
    std::atomic<bool> mProcessing;
    bool mRunningMainStages = false; // Main thread only
};

} // namespace zebaudiofilterhost
