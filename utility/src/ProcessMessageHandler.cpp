#include "utility/ProcessMessageHandler.h"

#include "utility/ThreadUtils.h"
#include "utility/src/MessageRingAccess.h"

#include <algorithm>
#include <iterator>
#include <utility>

namespace zebaudiofilterhost
{

namespace
{

class FlagWhileAlive
{
public:
    explicit FlagWhileAlive(bool& flag) : mFlag(flag) { mFlag = true; }
    ~FlagWhileAlive() { mFlag = false; }

    FlagWhileAlive(const FlagWhileAlive&) = delete;
    FlagWhileAlive& operator=(const FlagWhileAlive&) = delete;

private:
    bool& mFlag;
};

} // namespace

ProcessMessageHandler::ProcessMessageHandler() : mProcessing(false)
{
}

ProcessMessageHandler::~ProcessMessageHandler() = default;

void ProcessMessageHandler::FlushMessageQueue()
{
    if (CurrentThreadIDIsMainThreadID())
        PumpFromMainThread();
    else
        PumpFromProcessThread();
}

void ProcessMessageHandler::Post(boost::intrusive_ptr<Message> message)
{
    mMessages.push_back(std::move(message));
    TransferMessagesToQueue();
}

void ProcessMessageHandler::PumpFromMainThread()
{
    mFirstToLook = 0; // Whoever holds a message may have made it pending again
    TransferMessagesToQueue();
    if (!mProcessing.load(std::memory_order_relaxed))
        PumpFromProcessThread();
    RunMainStages();
    PurgeProcessedMessages();
    // Nothing may follow: the purge may have destroyed this object.
}

void ProcessMessageHandler::SetProcessing(bool processing)
{
    mProcessing.store(processing, std::memory_order_relaxed); // Read by the main thread only
}

void ProcessMessageHandler::TransferMessagesToQueue()
{
    // From where the last look ended: an application that posts many messages at once has each looked at once.
    for (; mFirstToLook < mMessages.size(); ++mFirstToLook)
    {
        const boost::intrusive_ptr<Message>& message = mMessages[mFirstToLook];
        if (message->GetState() != Message::kState_Pending)
            continue;
        message->SetState(Message::kState_Queued); // First, since the consumer may finish it at once
        if (!mRing.Push(message))
        {
            message->SetState(Message::kState_Pending);
            return; // Later messages wait too, so that the order of posting holds
        }
    }
}

void ProcessMessageHandler::RunMainStages()
{
    if (mRunningMainStages) // A stage that flushes must not be entered a second time; the outer loop does the rest
        return;
    const FlagWhileAlive running(mRunningMainStages);
    // By index and with a reference: a stage may post, which moves the list, or flush, which shortens it.
    for (std::size_t i = 0; i < mMessages.size(); ++i) // NOLINT(modernize-loop-convert)
    {
        if (mMessages[i]->GetState() != Message::kState_ProcessDone)
            continue;
        const boost::intrusive_ptr<Message> message = mMessages[i];
        bool done = true;
        try
        {
            done = message->ExecuteOnMainThread();
        }
        catch (...)
        {
            message->SetState(Message::kState_Finished); // Else each later pump would run it again, and end there
            throw;
        }
        message->SetState(done ? Message::kState_Finished : Message::kState_Pending);
        if (!done)
            mFirstToLook = 0; // Not its index, which a flush in the stage may have changed
    }
}

void ProcessMessageHandler::PurgeProcessedMessages()
{
    std::vector<Message*> finished;
    finished.reserve(mMessages.size());
    for (const boost::intrusive_ptr<Message>& message : mMessages)
    {
        if (message->GetState() == Message::kState_Finished)
            finished.push_back(message.get());
    }
    for (Message* message : finished)
    {
        if (message->GetRefCount() == 1) // The process thread may still hold one that it has just finished
            message->SetState(Message::kState_Deletable);
    }

    const auto deletable = std::stable_partition(mMessages.begin(), mMessages.end(),
                                                 [](const auto& message) { return !CanDeleteMessage(message); });
    // Released last, when the list is in order again: a message may hold the last reference to this object's owner.
    const MessageList doomed(std::make_move_iterator(deletable), std::make_move_iterator(mMessages.end()));
    mMessages.erase(deletable, mMessages.end());
    mFirstToLook = 0; // Places have changed
}

bool ProcessMessageHandler::CanDeleteMessage(boost::intrusive_ptr<Message> message)
{
    return message->GetState() == Message::kState_Deletable;
}

} // namespace zebaudiofilterhost
