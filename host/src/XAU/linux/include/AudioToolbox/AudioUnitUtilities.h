#pragma once

#include "AudioToolbox/AudioUnitProperties.h"

// Listeners to parameters, gestures and properties of units. A change is told by whoever makes it (Notify), on any
// thread, and heard on the run loop that the listener was made with, once in a notification interval; telling neither
// allocates nor locks, and takes no longer for a unit of many parameters. Of several changes of one parameter between
// two gestures the last is heard, and those that lie the granularity or more apart are all heard, in the order of
// telling. When more than 1,024 of them wait, those beyond are heard once for each parameter, with the value that it
// has then; of gestures each is heard, those beyond 1,024 by parameter. Listeners are made, changed and disposed of
// on their loop's thread. A unit may go before them: nothing more is heard of it, and it must not be named in a call
// any more, so that what listens to it is only disposed of.
//
// This host listens to gestures and to values in the global scope. A unit that changes a value by itself notifies;
// one that is set from outside does not: after SetParameter, a preset or class info the host tells of it, of the
// latter two with kAUParameterListener_AnyParameter.

struct AudioUnitParameter
{
    AudioUnit mAudioUnit;
    AudioUnitParameterID mParameterID;
    AudioUnitScope mScope;
    AudioUnitElement mElement;
};

struct AudioUnitProperty
{
    AudioUnit mAudioUnit;
    AudioUnitPropertyID mPropertyID;
    AudioUnitScope mScope;
    AudioUnitElement mElement;
};

using AudioUnitEventType = UInt32;

enum : AudioUnitEventType
{
    kAudioUnitEvent_ParameterValueChange = 0,
    kAudioUnitEvent_BeginParameterChangeGesture = 1,
    kAudioUnitEvent_EndParameterChangeGesture = 2,
    kAudioUnitEvent_PropertyChange = 3 // not told by itself: only what a unit's owner notifies
};

struct AudioUnitEvent
{
    AudioUnitEventType mEventType;
    union
    {
        AudioUnitParameter mParameter;
        AudioUnitProperty mProperty;
    } mArgument;
};

enum : AudioUnitParameterID
{
    kAUParameterListener_AnyParameter = 0xFFFFFFFF // in a notification: all that are listened to
};

using AUParameterListenerRef = struct AUListenerBase*;
using AUEventListenerRef = struct AUListenerBase*;

using AUEventListenerProc = void (*)(void* userData, void* object, const AudioUnitEvent* event, UInt64 hostTime,
                                     AudioUnitParameterValue value);

/// `notificationInterval` and `valueChangeGranularity` are in seconds.
CF_EXPORT OSStatus AUEventListenerCreate(AUEventListenerProc proc, void* userData, CFRunLoopRef runLoop,
                                         CFStringRef runLoopMode, Float32 notificationInterval,
                                         Float32 valueChangeGranularity, AUEventListenerRef* listener);
/// `object` comes back with each such event.
CF_EXPORT OSStatus AUEventListenerAddEventType(AUEventListenerRef listener, void* object,
                                               const AudioUnitEvent* event);
CF_EXPORT OSStatus AUEventListenerRemoveEventType(AUEventListenerRef listener, void* object,
                                                  const AudioUnitEvent* event);
/// What was told and not yet heard is lost.
CF_EXPORT OSStatus AUListenerDispose(AUParameterListenerRef listener);

/// Tells all listeners but the one of `sender` and `sendingObject`, if they are given: with a null object all of that
/// listener's. A value that has changed is read from its unit on this thread before the return: not to be called
/// under a lock that the unit's AudioUnitGetParameter takes. [any]
CF_EXPORT OSStatus AUEventListenerNotify(AUEventListenerRef sender, void* sendingObject, const AudioUnitEvent* event);
/// The same for a value that has changed. With kAUParameterListener_AnyParameter scope and element count for nothing.
/// [any]
CF_EXPORT OSStatus AUParameterListenerNotify(AUParameterListenerRef sender, void* sendingObject,
                                             const AudioUnitParameter* parameter);
/// Sets the value and tells of it. [any]
CF_EXPORT OSStatus AUParameterSet(AUParameterListenerRef sender, void* sendingObject,
                                  const AudioUnitParameter* parameter, AudioUnitParameterValue value,
                                  UInt32 bufferOffset);

static_assert(sizeof(AudioUnitParameter) == 24);
static_assert(sizeof(AudioUnitProperty) == 24);
static_assert(offsetof(AudioUnitEvent, mArgument) == 8);
static_assert(sizeof(AudioUnitEvent) == 32);
