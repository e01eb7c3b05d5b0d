#pragma once

#include "CoreFoundation/CoreFoundation.h"

// Sound as units and hosts hand it to each other: published names, numbers and layouts, for 64-bit processes.

inline constexpr OSStatus noErr = 0;
inline constexpr OSStatus kAudio_UnimplementedError = -4;
inline constexpr OSStatus kAudio_FileNotFoundError = -43;
inline constexpr OSStatus kAudio_ParamError = -50;
inline constexpr OSStatus kAudio_MemFullError = -108;

struct AudioBuffer
{
    UInt32 mNumberChannels; // interleaved in it
    UInt32 mDataByteSize;
    void* mData;
};

/// One buffer is declared; a list with more goes on behind it.
struct AudioBufferList
{
    UInt32 mNumberBuffers;
    AudioBuffer mBuffers[1];
};

using AudioFormatID = UInt32;
using AudioFormatFlags = UInt32;

inline constexpr AudioFormatID kAudioFormatLinearPCM = 0x6C70636D; // "lpcm"

enum : AudioFormatFlags
{
    kAudioFormatFlagIsFloat = 1U << 0,
    kAudioFormatFlagIsBigEndian = 1U << 1,
    kAudioFormatFlagIsSignedInteger = 1U << 2,
    kAudioFormatFlagIsPacked = 1U << 3,
    kAudioFormatFlagIsAlignedHigh = 1U << 4,
    kAudioFormatFlagIsNonInterleaved = 1U << 5
};

struct AudioStreamBasicDescription
{
    Float64 mSampleRate; // hertz
    AudioFormatID mFormatID;
    AudioFormatFlags mFormatFlags;
    UInt32 mBytesPerPacket;
    UInt32 mFramesPerPacket;
    UInt32 mBytesPerFrame;
    UInt32 mChannelsPerFrame;
    UInt32 mBitsPerChannel;
    UInt32 mReserved;
};

struct SMPTETime
{
    SInt16 mSubframes;
    SInt16 mSubframeDivisor;
    UInt32 mCounter;
    UInt32 mType;
    UInt32 mFlags;
    SInt16 mHours;
    SInt16 mMinutes;
    SInt16 mSeconds;
    SInt16 mFrames;
};

struct AudioTimeStamp
{
    Float64 mSampleTime; // frames
    UInt64 mHostTime;
    Float64 mRateScalar;
    UInt64 mWordClockTime;
    SMPTETime mSMPTETime;
    UInt32 mFlags; // which members count
    UInt32 mReserved;
};

enum AudioTimeStampFlags : UInt32
{
    kAudioTimeStampSampleTimeValid = 1U << 0,
    kAudioTimeStampHostTimeValid = 1U << 1,
    kAudioTimeStampRateScalarValid = 1U << 2,
    kAudioTimeStampWordClockTimeValid = 1U << 3,
    kAudioTimeStampSMPTETimeValid = 1U << 4
};

using AudioChannelLabel = UInt32;
using AudioChannelLayoutTag = UInt32; // the low half counts the channels
using AudioChannelBitmap = UInt32;
using AudioChannelFlags = UInt32;

enum : AudioChannelLabel
{
    kAudioChannelLabel_Unknown = 0xFFFFFFFF,
    kAudioChannelLabel_Unused = 0,
    kAudioChannelLabel_Left = 1,
    kAudioChannelLabel_Right = 2,
    kAudioChannelLabel_Center = 3,
    kAudioChannelLabel_LFEScreen = 4,
    kAudioChannelLabel_LeftSurround = 5,
    kAudioChannelLabel_RightSurround = 6,
    kAudioChannelLabel_LeftCenter = 7,
    kAudioChannelLabel_RightCenter = 8,
    kAudioChannelLabel_CenterSurround = 9,
    kAudioChannelLabel_Mono = 42,
    kAudioChannelLabel_HeadphonesLeft = 301,
    kAudioChannelLabel_HeadphonesRight = 302
};

enum : AudioChannelLayoutTag
{
    kAudioChannelLayoutTag_UseChannelDescriptions = 0U << 16,
    kAudioChannelLayoutTag_UseChannelBitmap = 1U << 16,
    kAudioChannelLayoutTag_Mono = (100U << 16) | 1,
    kAudioChannelLayoutTag_Stereo = (101U << 16) | 2,
    kAudioChannelLayoutTag_MPEG_5_1_A = (121U << 16) | 6
};

enum : AudioChannelBitmap
{
    kAudioChannelBit_Left = 1U << 0,
    kAudioChannelBit_Right = 1U << 1,
    kAudioChannelBit_Center = 1U << 2,
    kAudioChannelBit_LFEScreen = 1U << 3,
    kAudioChannelBit_LeftSurround = 1U << 4,
    kAudioChannelBit_RightSurround = 1U << 5
};

struct AudioChannelDescription
{
    AudioChannelLabel mChannelLabel;
    AudioChannelFlags mChannelFlags;
    Float32 mCoordinates[3];
};

/// One description is declared; a layout with more goes on behind it.
struct AudioChannelLayout
{
    AudioChannelLayoutTag mChannelLayoutTag;
    AudioChannelBitmap mChannelBitmap;
    UInt32 mNumberChannelDescriptions;
    AudioChannelDescription mChannelDescriptions[1];
};

static_assert(sizeof(AudioBuffer) == 16);
static_assert(offsetof(AudioBufferList, mBuffers) == 8);
static_assert(sizeof(AudioBufferList) == 24);
static_assert(sizeof(AudioStreamBasicDescription) == 40);
static_assert(sizeof(SMPTETime) == 24);
static_assert(offsetof(AudioTimeStamp, mFlags) == 56);
static_assert(sizeof(AudioTimeStamp) == 64);
static_assert(sizeof(AudioChannelDescription) == 20);
static_assert(sizeof(AudioChannelLayout) == 32);
