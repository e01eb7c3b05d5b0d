#include "AudioToolbox/AudioUnitUtilities.h"

#include "foundation/zebcore/HighPrecisionTime.h"
#include "host/src/XAU/linux/src/AUListener.h"
#include "host/src/XAU/linux/src/ComponentInstance.h"

#include <memory>

using namespace zebaudiofilterhost::xau;
using zebcore::utility::HighPrecisionTime;

namespace
{

// Null for an event without a unit.
const std::shared_ptr<ListenerTable>* FindTable(const AudioUnitEvent* event)
{
    AudioUnit const unit = event ? event->mArgument.mParameter.mAudioUnit : nullptr;
    return unit ? &unit->mListeners : nullptr;
}

bool IsSender(const ListenerRow& row, AUEventListenerRef sender, const void* sendingObject)
{
    return sender != nullptr && row.mListener == sender && (sendingObject == nullptr || row.mObject == sendingObject);
}

bool IsOfAllParameters(const AudioUnitEvent& event)
{
    return IsValueChange(event) && event.mArgument.mParameter.mParameterID == kAUParameterListener_AnyParameter;
}

AudioUnitParameterValue ReadValue(const AudioUnitEvent& event)
{
    AudioUnitParameterValue value = 0;
    const AudioUnitParameter& parameter = event.mArgument.mParameter;
    if (IsValueChange(event))
        AudioUnitGetParameter(parameter.mAudioUnit, parameter.mParameterID, parameter.mScope, parameter.mElement,
                              &value);
    return value;
}

} // namespace

OSStatus AUEventListenerCreate(AUEventListenerProc proc, void* userData, CFRunLoopRef runLoop,
                               CFStringRef /*runLoopMode*/, Float32 notificationInterval,
                               Float32 valueChangeGranularity, AUEventListenerRef* listener)
{
    if (!proc || !listener)
        return kAudio_ParamError;
    using Seconds = AUListenerBase::Seconds;
    *listener = new AUListenerBase(proc, userData, runLoop ? runLoop : CFRunLoopGetCurrent(),
                                   Seconds(notificationInterval), Seconds(valueChangeGranularity));
    return noErr;
}

OSStatus AUEventListenerAddEventType(AUEventListenerRef listener, void* object, const AudioUnitEvent* event)
{
    const auto* table = FindTable(event);
    if (!listener || !table)
        return kAudio_ParamError;
    listener->Add(*event, object, *table);
    return noErr;
}

OSStatus AUEventListenerRemoveEventType(AUEventListenerRef listener, void* object, const AudioUnitEvent* event)
{
    const auto* table = FindTable(event);
    if (!listener || !table)
        return kAudio_ParamError;
    listener->Remove(*event, object, *table);
    return noErr;
}

OSStatus AUListenerDispose(AUParameterListenerRef listener)
{
    if (!listener)
        return kAudio_ParamError;
    const std::unique_ptr<AUListenerBase> owner(listener);
    return noErr;
}

OSStatus AUEventListenerNotify(AUEventListenerRef sender, void* sendingObject, const AudioUnitEvent* event)
{
    const auto* table = FindTable(event);
    if (!table)
        return kAudio_ParamError;
    if (IsOfAllParameters(*event))
    {
        (*table)->ForEach(
            [&](ListenerRow& row)
            {
                if (IsValueChange(row.mEvent) && !IsSender(row, sender, sendingObject))
                    row.mListener->TellToRead(row);
            });
        return noErr;
    }
    bool isHeard = false;
    const auto isOther = [&](const ListenerRow& row)
    {
        return !IsSender(row, sender, sendingObject);
    };
    (*table)->ForEach(*event, [&](const ListenerRow& row) { isHeard = isHeard || isOther(row); });
    if (!isHeard)
        return noErr;
    // Not while the rows are read: whoever takes some out waits for the unit then.
    const AudioUnitParameterValue value = ReadValue(*event);
    const UInt64 now = HighPrecisionTime::ConvertToNanos(HighPrecisionTime::GetCurrentTime());
    (*table)->ForEach(*event,
                      [&](ListenerRow& row)
                      {
                          if (isOther(row))
                              row.mListener->Tell(row, now, value);
                      });
    return noErr;
}

OSStatus AUParameterListenerNotify(AUParameterListenerRef sender, void* sendingObject,
                                   const AudioUnitParameter* parameter)
{
    if (!parameter)
        return kAudio_ParamError;
    AudioUnitEvent event = {kAudioUnitEvent_ParameterValueChange, {*parameter}};
    return AUEventListenerNotify(sender, sendingObject, &event);
}

OSStatus AUParameterSet(AUParameterListenerRef sender, void* sendingObject, const AudioUnitParameter* parameter,
                        AudioUnitParameterValue value, UInt32 bufferOffset)
{
    if (!parameter)
        return kAudio_ParamError;
    const OSStatus result = AudioUnitSetParameter(parameter->mAudioUnit, parameter->mParameterID, parameter->mScope,
                                                  parameter->mElement, value, bufferOffset);
    return result == noErr ? AUParameterListenerNotify(sender, sendingObject, parameter) : result;
}
