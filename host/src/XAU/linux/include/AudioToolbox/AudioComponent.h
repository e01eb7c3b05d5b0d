#pragma once

#include "AudioToolbox/CoreAudioTypes.h"

// The registry of components and their instances.
//
// A component is registered by the process itself, or lies as a bundle `X.component` in one of the folders of
// $AUDIO_COMPONENT_PATH (separated by colons), else in ~/.components, /usr/local/lib/components and
// /usr/lib/components, or below them. Its Contents/Info.plist, XML or binary, has an array "AudioComponents" of
// dictionaries with the keys "type", "subtype" and "manufacturer" (strings of exactly four characters), "name"
// ("Maker: Name"), "version" (an integer, 0xMMMMmmbb; 0 if it is missing) and "factoryFunction" (the name of an
// AudioComponentFactoryFunction, extern "C" and of default visibility: CF_EXPORT). An entry that is not complete is
// left out; the trace category "ComponentBundle" tells which, and the key at fault.
//
//     <plist version="1.0"><dict>
//       <key>AudioComponents</key><array><dict>
//         <key>type</key><string>aufx</string>
//         <key>subtype</key><string>gain</string>
//         <key>manufacturer</key><string>Acme</string>
//         <key>name</key><string>Acme: Gain</string>
//         <key>version</key><integer>65536</integer>
//         <key>factoryFunction</key><string>MakeGain</string>
//       </dict></array>
//     </dict></plist>
//
// The binary is Contents/<architecture>-linux/X.so, with the X of the bundle. It is linked against nothing of the
// host: the functions named in these headers are those of the process that loads it, bound when they are first
// called. No binary is opened before an instance is asked for, and none is closed. Components are never forgotten.
// [main, but for what is called on an instance]

using AudioComponent = struct OpaqueAudioComponent*;
using AudioComponentInstance = struct ComponentInstanceRecord*;

struct AudioComponentDescription
{
    OSType componentType;
    OSType componentSubType;
    OSType componentManufacturer;
    UInt32 componentFlags;
    UInt32 componentFlagsMask;
};

/// A unit's function for one selector; null stands for one that it does not have. To be cast to the selector's type.
using AudioComponentMethod = OSStatus (*)(void* self, ...);

/// One instance of a unit, made by its factory. Memory and the members behind it are the unit's, which finds them by
/// `self`, the pointer that the factory gave:
///
///     struct Gain
///     {
///         AudioComponentPlugInInterface interface; // first
///         float factor;
///     };
///     OSStatus Close(void* self)
///     {
///         delete static_cast<Gain*>(self);
///         return noErr;
///     }
///     CF_EXPORT AudioComponentPlugInInterface* MakeGain(const AudioComponentDescription* description)
///     {
///         return &(new Gain{{Open, Close, Lookup, nullptr}, 1.0F})->interface;
///     }
struct AudioComponentPlugInInterface
{
    OSStatus (*Open)(void* self, AudioComponentInstance instance); // frees it on failure
    OSStatus (*Close)(void* self);                                 // frees it
    AudioComponentMethod (*Lookup)(SInt16 selector); // asked before Open, also for numbers that are no selector
    void* reserved;
};

/// Null if there is no instance to be had.
using AudioComponentFactoryFunction =
    AudioComponentPlugInInterface* (*)(const AudioComponentDescription* description);

inline constexpr OSStatus kAudioComponentErr_InstanceInvalidated = -66749;
inline constexpr OSStatus kAudioComponentErr_DuplicateDescription = -66752;
inline constexpr OSStatus kAudioComponentErr_UnsupportedType = -66751;
inline constexpr OSStatus kAudioComponentErr_TooManyInstances = -66750;
inline constexpr OSStatus kAudioComponentErr_NotPermitted = -66748;

/// The next one behind `after` (null: the first) that fits: a type, subtype or manufacturer of 0 fits any. Null at
/// the end.
CF_EXPORT AudioComponent AudioComponentFindNext(AudioComponent after, const AudioComponentDescription* description);
CF_EXPORT UInt32 AudioComponentCount(const AudioComponentDescription* description);
/// "Maker: Name", with a reference for the caller.
CF_EXPORT OSStatus AudioComponentCopyName(AudioComponent component, CFStringRef* name);
CF_EXPORT OSStatus AudioComponentGetDescription(AudioComponent component, AudioComponentDescription* description);
CF_EXPORT OSStatus AudioComponentGetVersion(AudioComponent component, UInt32* version);

/// Of this process alone. A description that is registered already gives the component that has it.
CF_EXPORT AudioComponent AudioComponentRegister(const AudioComponentDescription* description, CFStringRef name,
                                                UInt32 version, AudioComponentFactoryFunction factory);

/// Calls the factory, and Open of what it made. Close does not follow an Open that fails.
CF_EXPORT OSStatus AudioComponentInstanceNew(AudioComponent component, AudioComponentInstance* instance);
/// Calls Close.
CF_EXPORT OSStatus AudioComponentInstanceDispose(AudioComponentInstance instance);
CF_EXPORT AudioComponent AudioComponentInstanceGetComponent(AudioComponentInstance instance);

static_assert(sizeof(AudioComponentDescription) == 20);
static_assert(sizeof(AudioComponentPlugInInterface) == 32);
