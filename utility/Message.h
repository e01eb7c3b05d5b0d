// A command that travels from the main thread to the process thread.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"

#include <atomic>
#include <cstdint>

namespace zebaudiofilterhost
{

/// A command with two stages: one on the process thread and, if that asks for it, one on the main thread.
///
/// Held by boost::intrusive_ptr. A ProcessMessageHandler keeps every posted message alive on the main thread until
/// nobody else refers to it, so that the process thread never frees one.
class ZEB_EXPORT Message : public virtual zebcore::utility::RefCountedObject
{
public:
    enum State : std::int32_t
    {
        kState_Unused = 0,
        kState_Queued = 1,      ///< In the ring
        kState_Pending = 2,     ///< Waits for a place in the ring
        kState_ProcessDone = 3, ///< The process stage ran and asks for the main stage
        kState_Finished = 4,    ///< Both stages are over
        kState_Deletable = 5    ///< Only the message list still refers to it
    };

    Message();
    ~Message() override;

    Message(const Message&) = delete;
    Message& operator=(const Message&) = delete;

    /// The process stage. True: the message is done. False: it wants its main stage. Must not allocate, free, lock or
    /// call the system. [process]
    virtual bool ExecuteOnProcessThread();

    /// The main stage. True: the message is done. False: its process stage is to run again. [main]
    virtual bool ExecuteOnMainThread();

    /// Both are full barriers. [any]
    State GetState() const;
    void SetState(State state);

private:
    mutable std::atomic<std::int32_t> mState;
};

} // namespace zebaudiofilterhost
