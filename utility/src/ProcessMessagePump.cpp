// The consumer's side of the ring: runs on the process thread.
#include "utility/ProcessMessageHandler.h"
#include "utility/src/MessageRingAccess.h"

namespace zebaudiofilterhost
{

void ProcessMessageHandler::PumpFromProcessThread()
{
    // The message list holds a reference until after this one is gone, so nothing is freed here.
    for (boost::intrusive_ptr<Message> message; mRing.Pop(message); message.reset())
    {
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
