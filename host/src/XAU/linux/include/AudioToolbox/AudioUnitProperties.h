#pragma once

#include "AudioToolbox/AUComponent.h"

// Properties of units: published numbers and records.

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

struct AUChannelInfo
{
    SInt16 inChannels; // -1: any; below: up to so many
    SInt16 outChannels;
};

struct AURenderCallbackStruct
{
    AURenderCallback inputProc;
    void* inputProcRefCon;
};

struct AUPreset
{
    SInt32 presetNumber; // below 0: a user's
    CFStringRef presetName;
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
    kAudioUnitParameterFlag_CFNameRelease = 1U << 4, // whoever reads the info releases its strings
    kAudioUnitParameterFlag_NonRealTime = 1U << 24,
    kAudioUnitParameterFlag_CanRamp = 1U << 25,
    kAudioUnitParameterFlag_ExpertMode = 1U << 26,
    kAudioUnitParameterFlag_HasCFNameString = 1U << 27,
    kAudioUnitParameterFlag_IsHighResolution = 1U << 29,
    kAudioUnitParameterFlag_IsReadable = 1U << 30,
    kAudioUnitParameterFlag_IsWritable = 1U << 31
};

struct AudioUnitParameterInfo
{
    char name[52];
    CFStringRef unitName; // of a custom unit
    UInt32 clumpID;
    CFStringRef cfNameString;
    AudioUnitParameterUnit unit;
    AudioUnitParameterValue minValue;
    AudioUnitParameterValue maxValue;
    AudioUnitParameterValue defaultValue;
    UInt32 flags;
};

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
/// may be null.
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

// The entries of class info that all units have.
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
