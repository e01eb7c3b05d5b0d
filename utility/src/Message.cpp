#include "utility/Message.h"

#include "utility/src/MemoryOrder.h"

namespace zebaudiofilterhost
{

Message::Message() : mState(kState_Pending)
{
}

Message::~Message() = default;

bool Message::ExecuteOnProcessThread()
{
    return true;
}

bool Message::ExecuteOnMainThread()
{
    return true;
}

Message::State Message::GetState() const
{
    std::int32_t state = mState.load(std::memory_order_relaxed);
    // A swap with itself reads under a full barrier, which a plain load is not.
    while (!mState.compare_exchange_weak(
        state, state, OrderAt(OrderSite::kMessageGetState, std::memory_order_seq_cst), std::memory_order_relaxed))
    {
    }
    return static_cast<State>(state);
}

void Message::SetState(State state)
{
    mState.exchange(state, OrderAt(OrderSite::kMessageSetState, std::memory_order_seq_cst));
}

} // namespace zebaudiofilterhost
