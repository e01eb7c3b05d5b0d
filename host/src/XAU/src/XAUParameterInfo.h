#pragma once

#include "audiofilter/AudioFilterParameterInfo.h"
#include "host/src/XAU/src/CFOwner.h"

#include <AudioToolbox/AudioToolbox.h>

namespace zebaudiofilterhost::xau
{

/// What a unit says of a parameter, with the references on its texts that it hands over; all zero if it says nothing.
struct ParameterRecord
{
    /// [main]
    ParameterRecord(AudioUnit instance, AudioUnitScope scope, AudioUnitParameterID id);

    bool IsKnown() const { return mIsKnown; }
    bool HasName() const { return (mInfo.flags & kAudioUnitParameterFlag_HasCFNameString) != 0; }
    bool HasUnitName() const { return mInfo.unit == kAudioUnitParameterUnit_CustomUnit; }

    AudioUnitParameterInfo mInfo = {};

private:
    bool mIsKnown;
    CFOwner mName;
    CFOwner mUnitName;
};

/// A unit's description of one of its parameters. Values of the unit are linear in normalised ones. Uses the unit
/// without owning it, and must not outlive it.
class XAUParameterInfo : public AudioFilterParameterInfo
{
public:
    /// A parameter that the unit does not describe has no name and the range 0 to 0. [main]
    XAUParameterInfo(AudioUnit instance, AudioUnitScope scope, AudioUnitParameterID id);

    float ToNormalized(float value) const override;
    float FromNormalized(float normalized) const override;
    bool CanRamp() const override;
    bool CanBeAutomated() const override;
    UTF16String GetParameterString(float normalized) const override;
    int GetStepCount() const override;

    /// [any]
    AudioUnitScope GetScope() const { return mScope; }
    AudioUnitParameterID GetParameterID() const { return mParameterID; }

private:
    void ReadInfo();
    void ReadTexts(const ParameterRecord& record);
    bool IsWiderThanAFloat() const;
    float GetRange() const;

    AudioUnit mInstance;
    AudioUnitScope mScope;
    AudioUnitParameterID mParameterID;
    float mMinimum = 0.0F;
    float mMaximum = 0.0F;
    bool mCanRamp = false;
    int mStepCount = 0;
    UInt32 mFlags = 0;
};

} // namespace zebaudiofilterhost::xau
