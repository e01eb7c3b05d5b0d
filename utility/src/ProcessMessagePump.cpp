// The consumer's side of the ring: runs on the process thread.
#include "utility/ProcessMessageHandler.h"

#include <utility>

namespace zebaudiofilterhost
{

void ProcessMessageHandler::PumpFromProcessThread()
{
    for (;;)
    {
        // Read anew each time: while the main thread is the consumer, a message may pump from inside.
        const std::size_t read = mReadIndex.load(std::memory_order_relaxed); // Our own
        // Acquire: sees the place that the producer filled before it published the index.
        if (read == mWriteIndex.load(std::memory_order_acquire))
            return;

        // The message list holds a reference until after this one is gone, so nothing is freed here.
        const boost::intrusive_ptr<Message> message = std::move(mRing[read]);
        mReadIndex.store((read + 1) % kRingSize, std::memory_order_release); // Gives the empty place back
        bool done = true;
        try
        {
            done = message->ExecuteOnProcessThread();
        }
        catch (...)
        {
            message->SetState(Message::kState_Finished); // Else the list would keep it, and its filter, for ever
            throw;
        }
        message->SetState(done ? Message::kState_Finished : Message::kState_ProcessDone);
    }
}

} // namespace zebaudiofilterhost
