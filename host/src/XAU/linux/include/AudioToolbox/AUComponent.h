#pragma once

#include "AudioToolbox/AudioComponent.h"

// Calls on an instance of a unit. Each goes to the unit's function for its selector, on the calling thread, and
// nothing between allocates or locks; a unit that has no such function gives kAudio_UnimplementedError. [main] unless
// another tag is given.

using AudioUnit = AudioComponentInstance;
using AudioUnitPropertyID = UInt32;
using AudioUnitScope = UInt32;
using AudioUnitElement = UInt32;
using AudioUnitParameterID = UInt32;
using AudioUnitParameterValue = Float32;
using AudioUnitRenderActionFlags = UInt32;

enum : OSType
{
    // This host's search offers effects, music effects, mixers and panners.
    kAudioUnitType_Output = 0x61756F75,          // "auou"
    kAudioUnitType_MusicDevice = 0x61756D75,     // "aumu"
    kAudioUnitType_MusicEffect = 0x61756D66,     // "aumf"
    kAudioUnitType_FormatConverter = 0x61756663, // "aufc"
    kAudioUnitType_Effect = 0x61756678,          // "aufx"
    kAudioUnitType_Mixer = 0x61756D78,           // "aumx"
    kAudioUnitType_Panner = 0x6175706E,          // "aupn"
    kAudioUnitType_Generator = 0x6175676E,       // "augn"
    kAudioUnitType_OfflineEffect = 0x61756F6C    // "auol"
};

inline constexpr OSStatus kAudioUnitErr_InvalidProperty = -10879;
inline constexpr OSStatus kAudioUnitErr_InvalidParameter = -10878;
inline constexpr OSStatus kAudioUnitErr_InvalidElement = -10877;
inline constexpr OSStatus kAudioUnitErr_NoConnection = -10876;
inline constexpr OSStatus kAudioUnitErr_FailedInitialization = -10875;
inline constexpr OSStatus kAudioUnitErr_TooManyFramesToProcess = -10874;
inline constexpr OSStatus kAudioUnitErr_InvalidFile = -10871;
inline constexpr OSStatus kAudioUnitErr_FormatNotSupported = -10868;
inline constexpr OSStatus kAudioUnitErr_Uninitialized = -10867;
inline constexpr OSStatus kAudioUnitErr_InvalidScope = -10866;
inline constexpr OSStatus kAudioUnitErr_PropertyNotWritable = -10865;
inline constexpr OSStatus kAudioUnitErr_CannotDoInCurrentContext = -10863;
inline constexpr OSStatus kAudioUnitErr_InvalidPropertyValue = -10851;
inline constexpr OSStatus kAudioUnitErr_PropertyNotInUse = -10850;
inline constexpr OSStatus kAudioUnitErr_Initialized = -10849;
inline constexpr OSStatus kAudioUnitErr_Unauthorized = -10847;

enum : SInt16
{
    kAudioUnitInitializeSelect = 0x0001,
    kAudioUnitUninitializeSelect = 0x0002,
    kAudioUnitGetPropertyInfoSelect = 0x0003,
    kAudioUnitGetPropertySelect = 0x0004,
    kAudioUnitSetPropertySelect = 0x0005,
    kAudioUnitGetParameterSelect = 0x0006,
    kAudioUnitSetParameterSelect = 0x0007,
    kAudioUnitResetSelect = 0x0009,
    kAudioUnitRenderSelect = 0x000E,
    // Not used by this host.
    kAudioUnitAddPropertyListenerSelect = 0x000A,
    kAudioUnitRemovePropertyListenerSelect = 0x000B,
    kAudioUnitAddRenderNotifySelect = 0x000F,
    kAudioUnitRemoveRenderNotifySelect = 0x0010,
    kAudioUnitScheduleParametersSelect = 0x0011,
    kAudioUnitRemovePropertyListenerWithUserDataSelect = 0x0012
};

using AudioUnitPropertyListenerProc = void (*)(void* refCon, AudioUnit unit, AudioUnitPropertyID property,
                                               AudioUnitScope scope, AudioUnitElement element);

/// An input's sound, for a unit that renders: it passes flags of 0, the time that it was given, the number of the
/// input as `bus`, at most the frames that it is to render, and a list with one buffer for each channel of the input.
/// A buffer with memory is filled; one whose mData is null comes back with a pointer to the host's memory, only to be
/// read, until the render ends. Either way the unit uses the pointers that are in the list after the call. From a
/// second input on it has to bring memory. What the host has no channel for is left as it is, or silent. [process]
using AURenderCallback = OSStatus (*)(void* refCon, AudioUnitRenderActionFlags* flags, const AudioTimeStamp* time,
                                      UInt32 bus, UInt32 frames, AudioBufferList* data);

// The unit's side, by selector. Pointers to sizes, flags, times, buffer lists and values never are null, nor is the
// data of a get. The data of a set comes as the caller gave it, null too. It is the unit that checks sizes, and
// refuses those that are too small (kAudio_ParamError, kAudioUnitErr_InvalidPropertyValue).
using AudioUnitInitializeProc = OSStatus (*)(void* self);
using AudioUnitUninitializeProc = OSStatus (*)(void* self);
using AudioUnitGetPropertyInfoProc = OSStatus (*)(void* self, AudioUnitPropertyID property, AudioUnitScope scope,
                                                  AudioUnitElement element, UInt32* size, Boolean* isWritable);
using AudioUnitGetPropertyProc = OSStatus (*)(void* self, AudioUnitPropertyID property, AudioUnitScope scope,
                                              AudioUnitElement element, void* data, UInt32* size);
using AudioUnitSetPropertyProc = OSStatus (*)(void* self, AudioUnitPropertyID property, AudioUnitScope scope,
                                              AudioUnitElement element, const void* data, UInt32 size);
using AudioUnitAddPropertyListenerProc = OSStatus (*)(void* self, AudioUnitPropertyID property,
                                                      AudioUnitPropertyListenerProc listener, void* refCon);
using AudioUnitRemovePropertyListenerWithUserDataProc = OSStatus (*)(void* self, AudioUnitPropertyID property,
                                                                     AudioUnitPropertyListenerProc listener,
                                                                     void* refCon);
using AudioUnitAddRenderNotifyProc = OSStatus (*)(void* self, AURenderCallback callback, void* refCon);
using AudioUnitRemoveRenderNotifyProc = OSStatus (*)(void* self, AURenderCallback callback, void* refCon);
using AudioUnitGetParameterProc = OSStatus (*)(void* self, AudioUnitParameterID parameter, AudioUnitScope scope,
                                               AudioUnitElement element, AudioUnitParameterValue* value);
using AudioUnitSetParameterProc = OSStatus (*)(void* self, AudioUnitParameterID parameter, AudioUnitScope scope,
                                               AudioUnitElement element, AudioUnitParameterValue value,
                                               UInt32 bufferOffset);
using AudioUnitResetProc = OSStatus (*)(void* self, AudioUnitScope scope, AudioUnitElement element);
using AudioUnitRenderProc = OSStatus (*)(void* self, AudioUnitRenderActionFlags* flags, const AudioTimeStamp* time,
                                         UInt32 bus, UInt32 frames, AudioBufferList* data);

CF_EXPORT OSStatus AudioUnitInitialize(AudioUnit unit);
CF_EXPORT OSStatus AudioUnitUninitialize(AudioUnit unit);
/// Either output may be null.
CF_EXPORT OSStatus AudioUnitGetPropertyInfo(AudioUnit unit, AudioUnitPropertyID property, AudioUnitScope scope,
                                            AudioUnitElement element, UInt32* size, Boolean* isWritable);
/// `size` is that of `data` before and what was written after. With null `data` it becomes the property's size.
///
/// An object in a result (class info, an array, an element's name, a parameter's outString) is by custom a reference
/// for the caller; AudioUnitParameterInfo's flags tell of its strings. This host releases names and arrays. Class
/// info and texts of parameters it deliberately does not: units differ in whose they are, and one that keeps them
/// would be left with a dead object.
CF_EXPORT OSStatus AudioUnitGetProperty(AudioUnit unit, AudioUnitPropertyID property, AudioUnitScope scope,
                                        AudioUnitElement element, void* data, UInt32* size);
/// An object that is set stays the caller's; a unit that keeps it retains it.
CF_EXPORT OSStatus AudioUnitSetProperty(AudioUnit unit, AudioUnitPropertyID property, AudioUnitScope scope,
                                        AudioUnitElement element, const void* data, UInt32 size);
CF_EXPORT OSStatus AudioUnitAddPropertyListener(AudioUnit unit, AudioUnitPropertyID property,
                                                AudioUnitPropertyListenerProc listener, void* refCon);
CF_EXPORT OSStatus AudioUnitRemovePropertyListenerWithUserData(AudioUnit unit, AudioUnitPropertyID property,
                                                               AudioUnitPropertyListenerProc listener, void* refCon);
CF_EXPORT OSStatus AudioUnitAddRenderNotify(AudioUnit unit, AURenderCallback callback, void* refCon);
CF_EXPORT OSStatus AudioUnitRemoveRenderNotify(AudioUnit unit, AURenderCallback callback, void* refCon);
/// Also beside a render. [any]
CF_EXPORT OSStatus AudioUnitGetParameter(AudioUnit unit, AudioUnitParameterID parameter, AudioUnitScope scope,
                                         AudioUnitElement element, AudioUnitParameterValue* value);
/// From frame `bufferOffset` of the next render on; this host's is always 0. It calls on the process thread between
/// renders, and from a view on the main thread, also beside a render. [any]
CF_EXPORT OSStatus AudioUnitSetParameter(AudioUnit unit, AudioUnitParameterID parameter, AudioUnitScope scope,
                                         AudioUnitElement element, AudioUnitParameterValue value,
                                         UInt32 bufferOffset);
/// Forgets the sound so far, not the parameters. Before each run this host calls it in the global scope, once for
/// each input with its number as the element; a unit without inputs is not called.
CF_EXPORT OSStatus AudioUnitReset(AudioUnit unit, AudioUnitScope scope, AudioUnitElement element);
/// One block of output `bus`, of at most kAudioUnitProperty_MaximumFramesPerSlice frames, from an initialised unit.
/// `data` has one buffer for each channel (this host's for those of all outputs, in their order). Where mData is
/// null, as always from this host, the unit points it to memory of its own or of an input, which stays valid until
/// the next render; other memory it fills. mDataByteSize becomes the size of the frames. This host asks for bus 0
/// with flags of 0; after an error, and for a channel whose mData stays null, it takes over nothing. [process]
CF_EXPORT OSStatus AudioUnitRender(AudioUnit unit, AudioUnitRenderActionFlags* flags, const AudioTimeStamp* time,
                                   UInt32 bus, UInt32 frames, AudioBufferList* data);
