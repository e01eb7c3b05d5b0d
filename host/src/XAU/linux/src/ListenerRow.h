#pragma once

#include "AudioToolbox/AudioUnitUtilities.h"

#include <atomic>
#include <memory>
#include <utility>

namespace zebaudiofilterhost::xau
{

class ListenerTable;

/// Whether both name the same change of the same thing.
bool IsSameEvent(const AudioUnitEvent& a, const AudioUnitEvent& b);

inline bool IsValueChange(const AudioUnitEvent& event)
{
    return event.mEventType == kAudioUnitEvent_ParameterValueChange;
}

/// One thing of one unit that a listener wants to hear. The listener's own; the unit's table refers to it.
struct ListenerRow : std::enable_shared_from_this<ListenerRow>
{
    ListenerRow(AUListenerBase* listener, const AudioUnitEvent& event, void* object,
                std::shared_ptr<ListenerTable> table)
        : mListener(listener), mEvent(event), mObject(object), mTable(std::move(table))
    {
    }

    AUListenerBase* const mListener;
    const AudioUnitEvent mEvent;
    void* const mObject;
    const std::shared_ptr<ListenerTable> mTable; // also when the unit has gone

    // What was told and did not go into the listener's queues.
    std::atomic<UInt32> mLeftOut = 0;
    std::atomic<UInt64> mLastLeftOut = 0; // the number that it has there

    // The listener's thread.
    bool mIsWanted = true; // until it is taken out
    UInt64 mHeardPart = 0; // between two gestures: where the next of the values that wait stands
    UInt64 mHeardTime = 0; // nanoseconds
};

} // namespace zebaudiofilterhost::xau
