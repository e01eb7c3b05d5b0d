#pragma once

#include "AudioToolbox/AUComponent.h"

// Properties of units: published numbers and records.
//
// Those that this host uses. Those with a star it needs: without them a unit has no buses, or is asked for more
// frames than it has room for. Any other may be missing, with kAudioUnitErr_InvalidProperty. Element is 0 unless it
// says more. [main]
//
//     Property                   Scope          Element
//     ElementCount *             input, output            read
//     StreamFormat *             input, output  bus       read; set only while uninitialised
//     MaximumFramesPerSlice *    global                   set only while uninitialised
//     SetRenderCallback *        input          bus       set after Initialize, before each run; if it has inputs
//     HostCallbacks              global                   set once, before the first Initialize
//     SupportedNumChannels       global                   read before formats are set
//     AudioChannelLayout         input, output  bus       read after formats are set, the size first
//     ElementName                input          bus       read after formats are set
//     Latency                    global                   read
//     ParameterList              global                   read when the unit is made, and by a view
//     ParameterInfo              global         ID        the same
//     ParameterValueStrings      global         ID        read by a view, of indexed parameters
//     ParameterStringFromValue   global                   read
//     FactoryPresets             global                   read once, when the unit is made
//     PresentPreset              global                   set, also beside a render
//     ClassInfo                  global                   read and set, also beside a render
//
// It has no use for the others: MakeConnection, SampleRate, TailTime, BypassEffect, LastRenderError, CocoaUI,
// SupportedChannelLayoutTags, OfflineRender, ParameterValueFromString.
//
// Initialised units are uninitialised for what wants that, and initialised again. The host reads the formats that a
// unit has and sets them with another mSampleRate; where it chooses the channels, of bus 0 on either side, it asks
// for 32-bit floats of native order, packed and not interleaved: mFormatFlags 0x29, mFramesPerPacket 1,
// mBytesPerPacket and mBytesPerFrame 4 (one channel's), mBitsPerChannel 32. Start with that format too: no other is
// rendered right.
//
// Parameters lie in the global scope. The other scopes are asked for the size of their list as well, and a unit that
// gives one there has its global parameters listed twice.

enum : AudioUnitScope
{
    kAudioUnitScope_Global = 0,
    kAudioUnitScope_Input = 1,
    kAudioUnitScope_Output = 2,
    kAudioUnitScope_Group = 3,
    kAudioUnitScope_Part = 4,
    kAudioUnitScope_Note = 5
};

enum : AudioUnitPropertyID
{
    kAudioUnitProperty_ClassInfo = 0, // CFPropertyListRef
    kAudioUnitProperty_MakeConnection = 1,
    kAudioUnitProperty_SampleRate = 2,                  // Float64
    kAudioUnitProperty_ParameterList = 3,               // AudioUnitParameterID[]
    kAudioUnitProperty_ParameterInfo = 4,               // AudioUnitParameterInfo; the element is the parameter's ID
    kAudioUnitProperty_StreamFormat = 8,                // AudioStreamBasicDescription
    kAudioUnitProperty_ElementCount = 11,               // UInt32
    kAudioUnitProperty_Latency = 12,                    // Float64, seconds
    kAudioUnitProperty_SupportedNumChannels = 13,       // AUChannelInfo[]
    kAudioUnitProperty_MaximumFramesPerSlice = 14,      // UInt32
    kAudioUnitProperty_ParameterValueStrings = 16,      // CFArrayRef
    kAudioUnitProperty_AudioChannelLayout = 19,         // AudioChannelLayout
    kAudioUnitProperty_TailTime = 20,                   // Float64, seconds
    kAudioUnitProperty_BypassEffect = 21,               // UInt32
    kAudioUnitProperty_LastRenderError = 22,            // OSStatus
    kAudioUnitProperty_SetRenderCallback = 23,          // AURenderCallbackStruct
    kAudioUnitProperty_FactoryPresets = 24,             // CFArrayRef of AUPreset*
    kAudioUnitProperty_HostCallbacks = 27,              // HostCallbackInfo
    kAudioUnitProperty_ElementName = 30,                // CFStringRef
    kAudioUnitProperty_CocoaUI = 31,                    // AudioUnitCocoaViewInfo
    kAudioUnitProperty_SupportedChannelLayoutTags = 32, // AudioChannelLayoutTag[]
    kAudioUnitProperty_ParameterStringFromValue = 33,   // AudioUnitParameterStringFromValue
    kAudioUnitProperty_PresentPreset = 36,              // AUPreset
    kAudioUnitProperty_OfflineRender = 37,              // UInt32
    kAudioUnitProperty_ParameterValueFromString = 38    // AudioUnitParameterValueFromString
};

/// Counts of channels that a unit works with. {-1, -1} are any two that are equal, {-1, -2} in this order any two.
/// The host asks for the nearest pair. Without the property it asks for what it wants; the unit may always refuse the
/// format, and keeps the one that it has.
struct AUChannelInfo
{
    SInt16 inChannels; // -1: any; below: up to so many
    SInt16 outChannels;
};

struct AURenderCallbackStruct
{
    AURenderCallback inputProc; // null: nothing is connected, the input is silent
    void* inputProcRefCon;
};

/// The array of factory presets points to such records: it is made with null callbacks, and the unit keeps records
/// and names until Close. The host sets PresentPreset to a copy of one.
struct AUPreset
{
    SInt32 presetNumber;    // below 0: a user's
    CFStringRef presetName; // may be null
};

using AudioUnitParameterUnit = UInt32;

enum : AudioUnitParameterUnit
{
    kAudioUnitParameterUnit_Generic = 0,
    kAudioUnitParameterUnit_Indexed = 1,
    kAudioUnitParameterUnit_Boolean = 2,
    kAudioUnitParameterUnit_Percent = 3,
    kAudioUnitParameterUnit_Seconds = 4,
    kAudioUnitParameterUnit_SampleFrames = 5,
    kAudioUnitParameterUnit_Phase = 6,
    kAudioUnitParameterUnit_Rate = 7,
    kAudioUnitParameterUnit_Hertz = 8,
    kAudioUnitParameterUnit_Cents = 9,
    kAudioUnitParameterUnit_RelativeSemiTones = 10,
    kAudioUnitParameterUnit_MIDINoteNumber = 11,
    kAudioUnitParameterUnit_MIDIController = 12,
    kAudioUnitParameterUnit_Decibels = 13,
    kAudioUnitParameterUnit_LinearGain = 14,
    kAudioUnitParameterUnit_Degrees = 15,
    kAudioUnitParameterUnit_EqualPowerCrossfade = 16,
    kAudioUnitParameterUnit_MixerFaderCurve1 = 17,
    kAudioUnitParameterUnit_Pan = 18,
    kAudioUnitParameterUnit_Meters = 19,
    kAudioUnitParameterUnit_AbsoluteCents = 20,
    kAudioUnitParameterUnit_Octaves = 21,
    kAudioUnitParameterUnit_BPM = 22,
    kAudioUnitParameterUnit_Beats = 23,
    kAudioUnitParameterUnit_Milliseconds = 24,
    kAudioUnitParameterUnit_Ratio = 25,
    kAudioUnitParameterUnit_CustomUnit = 26
};

enum AudioUnitParameterOptions : UInt32
{
    // Whoever reads the info releases its strings; without the flag the unit keeps them alive until Close.
    kAudioUnitParameterFlag_CFNameRelease = 1U << 4,
    // A level to be watched: a view reads it again and again.
    kAudioUnitParameterFlag_MeterReadOnly = 1U << 15,
    // No difference to this host.
    kAudioUnitParameterFlag_IsHighResolution = 1U << 23,
    // Not to be automated, and hidden from the application's lists; this host's view marks it.
    kAudioUnitParameterFlag_NonRealTime = 1U << 24,
    kAudioUnitParameterFlag_CanRamp = 1U << 25,
    kAudioUnitParameterFlag_ExpertMode = 1U << 26,      // no difference to this host
    kAudioUnitParameterFlag_HasCFNameString = 1U << 27, // cfNameString counts, and `name` does not
    kAudioUnitParameterFlag_IsReadable = 1U << 30,      // no difference to this host
    kAudioUnitParameterFlag_IsWritable = 1U << 31       // without it a view only shows the value
};

/// An indexed parameter has the whole numbers from minValue to maxValue; ParameterValueStrings names them, one string
/// for each from minValue on.
struct AudioUnitParameterInfo
{
    char name[52];        // ASCII
    CFStringRef unitName; // of kAudioUnitParameterUnit_CustomUnit alone
    UInt32 clumpID;
    CFStringRef cfNameString;
    AudioUnitParameterUnit unit;
    AudioUnitParameterValue minValue;
    AudioUnitParameterValue maxValue;
    AudioUnitParameterValue defaultValue;
    UInt32 flags;
};

/// A get whose record is input and output: it arrives with the first two members, and the unit writes the third.
struct AudioUnitParameterStringFromValue
{
    AudioUnitParameterID inParamID;
    const AudioUnitParameterValue* inValue; // null: the current one
    CFStringRef outString;
};

struct AudioUnitParameterValueFromString
{
    AudioUnitParameterID inParamID;
    CFStringRef inString;
    AudioUnitParameterValue outValue;
};

/// What a unit may ask of its host while it renders; each answers 0 and writes what is asked for and known. Outputs
/// may be null, and so may members of the record: this host has no transportStateProc2. [process]
using HostCallback_GetBeatAndTempo = OSStatus (*)(void* hostUserData, Float64* beat, Float64* tempo);
using HostCallback_GetMusicalTimeLocation = OSStatus (*)(void* hostUserData, UInt32* deltaToNextBeat,
                                                         Float32* numerator, UInt32* denominator,
                                                         Float64* measureDownBeat);
using HostCallback_GetTransportState = OSStatus (*)(void* hostUserData, Boolean* isPlaying, Boolean* hasChanged,
                                                    Float64* sampleInTimeLine, Boolean* isCycling,
                                                    Float64* cycleStart, Float64* cycleEnd);
using HostCallback_GetTransportState2 = OSStatus (*)(void* hostUserData, Boolean* isPlaying, Boolean* isRecording,
                                                     Boolean* hasChanged, Float64* sampleInTimeLine,
                                                     Boolean* isCycling, Float64* cycleStart, Float64* cycleEnd);

struct HostCallbackInfo
{
    void* hostUserData;
    HostCallback_GetBeatAndTempo beatAndTempoProc;
    HostCallback_GetMusicalTimeLocation musicalTimeLocationProc;
    HostCallback_GetTransportState transportStateProc;
    HostCallback_GetTransportState2 transportStateProc2;
};

// The entries of class info that all units have, by custom: this host looks at none, and keeps class info as a binary
// property list. Type, subtype, manufacturer and version are numbers (kCFNumberSInt32Type), the name is a string, the
// data bytes of the unit's own (CFDataRef). More entries are the unit's business. What comes back may have numbers of
// another type, which CFNumberGetValue converts.
#define kAUPresetTypeKey "type"
#define kAUPresetSubtypeKey "subtype"
#define kAUPresetManufacturerKey "manufacturer"
#define kAUPresetVersionKey "version"
#define kAUPresetNameKey "name"
#define kAUPresetDataKey "data"

static_assert(sizeof(AUChannelInfo) == 4);
static_assert(sizeof(AURenderCallbackStruct) == 16);
static_assert(sizeof(AUPreset) == 16);
static_assert(offsetof(AudioUnitParameterInfo, unitName) == 56);
static_assert(offsetof(AudioUnitParameterInfo, clumpID) == 64);
static_assert(offsetof(AudioUnitParameterInfo, cfNameString) == 72);
static_assert(offsetof(AudioUnitParameterInfo, unit) == 80);
static_assert(offsetof(AudioUnitParameterInfo, flags) == 96);
static_assert(sizeof(AudioUnitParameterInfo) == 104);
static_assert(sizeof(AudioUnitParameterStringFromValue) == 24);
static_assert(sizeof(AudioUnitParameterValueFromString) == 24);
static_assert(sizeof(HostCallbackInfo) == 40);
