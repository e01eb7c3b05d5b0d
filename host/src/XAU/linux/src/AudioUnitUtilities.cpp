#include "AudioToolbox/AudioUnitUtilities.h"

#include "foundation/zebcore/HighPrecisionTime.h"
#include "host/src/XAU/linux/src/AUListener.h"
#include "host/src/XAU/linux/src/ComponentInstance.h"

#include <algorithm>
#include <memory>
#include <set>

using namespace zebaudiofilterhost::xau;
using zebcore::utility::HighPrecisionTime;

namespace
{

using Row = ListenerTable::Row;

ListenerTable* FindTable(const AudioUnitEvent& event)
{
    AudioUnit const unit = event.mArgument.mParameter.mAudioUnit;
    return unit ? &unit->mListeners : nullptr;
}

bool IsSender(const Row& row, AUEventListenerRef sender, const void* sendingObject)
{
    return sender != nullptr && row.mListener == sender &&
           (sendingObject == nullptr || row.mInterest.mObject == sendingObject);
}

bool Concerns(const Interest& interest, const AudioUnitEvent& event)
{
    const AudioUnitParameter& told = event.mArgument.mParameter;
    if (event.mEventType == kAudioUnitEvent_ParameterValueChange &&
        told.mParameterID == kAUParameterListener_AnyParameter)
        return interest.mEvent.mEventType == event.mEventType &&
               interest.mEvent.mArgument.mParameter.mAudioUnit == told.mAudioUnit;
    return IsSameEvent(interest.mEvent, event);
}

AudioUnitParameterValue ReadValue(const AudioUnitEvent& event)
{
    AudioUnitParameterValue value = 0;
    const AudioUnitParameter& parameter = event.mArgument.mParameter;
    if (event.mEventType == kAudioUnitEvent_ParameterValueChange)
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
    ListenerTable* table = listener && event ? FindTable(*event) : nullptr;
    if (!table)
        return kAudio_ParamError;
    const Interest interest{*event, object};
    auto& interests = listener->mInterests;
    if (std::find(interests.begin(), interests.end(), interest) != interests.end())
        return noErr;
    interests.push_back(interest);
    table->Append(listener, interest);
    return noErr;
}

OSStatus AUEventListenerRemoveEventType(AUEventListenerRef listener, void* object, const AudioUnitEvent* event)
{
    ListenerTable* table = listener && event ? FindTable(*event) : nullptr;
    if (!table)
        return kAudio_ParamError;
    const Interest interest{*event, object};
    if (std::erase(listener->mInterests, interest) > 0)
        table->Remove([&](const Row& row) { return row.mListener == listener && row.mInterest == interest; });
    return noErr;
}

OSStatus AUListenerDispose(AUParameterListenerRef listener)
{
    if (!listener)
        return kAudio_ParamError;
    const std::unique_ptr<AUListenerBase> owner(listener);
    std::set<ListenerTable*> tables;
    for (const Interest& interest : listener->mInterests)
        tables.insert(FindTable(interest.mEvent));
    for (ListenerTable* table : tables)
        table->Remove([listener](const Row& row) { return row.mListener == listener; });
    return noErr;
}

OSStatus AUEventListenerNotify(AUEventListenerRef sender, void* sendingObject, const AudioUnitEvent* event)
{
    ListenerTable* table = event ? FindTable(*event) : nullptr;
    if (!table)
        return kAudio_ParamError;
    const UInt64 now = HighPrecisionTime::ConvertToNanos(HighPrecisionTime::GetCurrentTime());
    table->ForEach(
        [&](const Row& row)
        {
            if (!IsSender(row, sender, sendingObject) && Concerns(row.mInterest, *event))
                row.mListener->Tell({row.mInterest, now, ReadValue(row.mInterest.mEvent)});
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
