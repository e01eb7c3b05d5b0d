// What the orders of the message ring and of a message's state hold up, one thing after the other.
#include "tests/rings/Handover.h"
#include "utility/src/MessageRingAccess.h"

using namespace zebaudiofilterhost;
using zebaudiofilterhost::testing::DoOnTwoThreads;

namespace
{

constexpr int kPlaces = 33;

using MessagePtr = boost::intrusive_ptr<Message>;

void PushAndPop()
{
    const MessagePtr message(new Message);
    MessageRing ring;
    MessagePtr popped;
    DoOnTwoThreads([&] { ring.Push(message); }, [&] { ring.Pop(popped); });
}

// The producer comes round to a place that the consumer has emptied.
void PopAndPushAgain()
{
    const MessagePtr message(new Message);
    MessageRing ring;
    ring.Push(message);
    ring.Push(message);
    DoOnTwoThreads(
        [&]
        {
            MessagePtr popped;
            ring.Pop(popped);
            ring.Pop(popped);
        },
        [&]
        {
            for (int number = 2; number <= kPlaces; ++number)
                ring.Push(message);
        });
}

void ChangeStateAndAsk()
{
    const MessagePtr message(new Message);
    int result = 0;
    DoOnTwoThreads(
        [&]
        {
            result = 1;
            message->SetState(Message::kState_ProcessDone);
        },
        [&]
        {
            if (message->GetState() == Message::kState_ProcessDone)
                ++result;
        });
}

} // namespace

int main()
{
    PushAndPop();
    PopAndPushAgain();
    ChangeStateAndAsk();
}
