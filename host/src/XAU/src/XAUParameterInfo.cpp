#include "host/src/XAU/src/XAUParameterInfo.h"

#include "foundation/zebcore/StringStreams.h"
#include "host/src/XAU/src/CFOwner.h"
#include "host/src/XAU/src/CallGuarded.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <map>

namespace zebaudiofilterhost::xau
{

namespace
{

// Labels of the units that have one. The rate, for instance, has none.
const UTF16String& LabelOf(AudioUnitParameterUnit unit)
{
    static const std::map<AudioUnitParameterUnit, UTF16String> sUnitMap = {
        {kAudioUnitParameterUnit_Percent, u"%"},
        {kAudioUnitParameterUnit_Seconds, u"s"},
        {kAudioUnitParameterUnit_SampleFrames, u"Samples"},
        {kAudioUnitParameterUnit_Phase, u"o"},
        {kAudioUnitParameterUnit_Hertz, u"Hz"},
        {kAudioUnitParameterUnit_Cents, u"Cents"},
        {kAudioUnitParameterUnit_RelativeSemiTones, u"S-T"},
        {kAudioUnitParameterUnit_Decibels, u"dB"},
        {kAudioUnitParameterUnit_Degrees, u"o"},
        {kAudioUnitParameterUnit_Meters, u"m"},
        {kAudioUnitParameterUnit_AbsoluteCents, u"Cents"},
        {kAudioUnitParameterUnit_Octaves, u"Oct"},
        {kAudioUnitParameterUnit_BPM, u"BPM"},
        {kAudioUnitParameterUnit_Milliseconds, u"ms"},
    };
    static const UTF16String sNone;
    const auto found = sUnitMap.find(unit);
    return found == sUnitMap.end() ? sNone : found->second;
}

// The 8-bit name of a unit that has no other: ASCII, and not always with a zero at its end.
UTF16String FromAscii(const char* text, std::size_t size)
{
    constexpr unsigned char kFirstNonAscii = 0x80;
    UTF16String units;
    for (std::size_t index = 0; index < size && text[index] != '\0'; ++index)
    {
        const auto byte = static_cast<unsigned char>(text[index]);
        units.push_back(byte < kFirstNonAscii ? static_cast<char16_t>(byte) : u'?');
    }
    return units;
}

int CountSteps(float minimum, float maximum)
{
    const double range = std::trunc(static_cast<double>(maximum - minimum));
    constexpr double kMost = std::numeric_limits<int>::max();
    return std::isnan(range) ? 0 : static_cast<int>(std::clamp(range, -kMost, kMost));
}

float ToFloat(double value)
{
    constexpr double kMost = std::numeric_limits<float>::max();
    return static_cast<float>(std::clamp(value, -kMost, kMost));
}

} // namespace

// Texts that the unit has made for the reader alone are released with the record.
ParameterRecord::ParameterRecord(AudioUnit instance, AudioUnitScope scope, AudioUnitParameterID id)
{
    UInt32 size = sizeof(mInfo);
    mIsKnown = CallGuarded<AudioUnitGetProperty>(instance, kAudioUnitProperty_ParameterInfo, scope, id, &mInfo,
                                                 &size) == noErr;
    const bool releases = mIsKnown && (mInfo.flags & kAudioUnitParameterFlag_CFNameRelease) != 0;
    mName.reset(releases && HasName() ? mInfo.cfNameString : nullptr);
    mUnitName.reset(releases && HasUnitName() ? mInfo.unitName : nullptr);
}

XAUParameterInfo::XAUParameterInfo(AudioUnit instance, AudioUnitScope scope, AudioUnitParameterID id)
    : mInstance(instance), mScope(scope), mParameterID(id)
{
    ReadInfo();
    SetExposed((mFlags & kAudioUnitParameterFlag_NonRealTime) == 0); // what can't be automated is not shown
}

void XAUParameterInfo::ReadInfo()
{
    const ParameterRecord record(mInstance, mScope, mParameterID);
    if (!record.IsKnown())
        return;
    const AudioUnitParameterInfo& info = record.mInfo;
    mMinimum = info.minValue;
    mMaximum = info.maxValue;
    ReadTexts(record);
    mCanRamp = (info.flags & kAudioUnitParameterFlag_CanRamp) != 0;
    if (info.unit == kAudioUnitParameterUnit_Indexed)
        mStepCount = CountSteps(mMinimum, mMaximum);
    else if (info.unit == kAudioUnitParameterUnit_Boolean)
        mStepCount = 1;
    mFlags = info.flags;
}

void XAUParameterInfo::ReadTexts(const ParameterRecord& record)
{
    const AudioUnitParameterInfo& info = record.mInfo;
    SetName(record.HasName() ? MACtoZEB(info.cfNameString) : FromAscii(std::data(info.name), std::size(info.name)));
    SetLabel(record.HasUnitName() ? MACtoZEB(info.unitName) : LabelOf(info.unit));
}

// Of finite bounds, such as those of a unit that gives the largest of all floats and its negative.
bool XAUParameterInfo::IsWiderThanAFloat() const
{
    const float range = mMaximum - mMinimum;
    return range > 0.0F && std::isinf(range) && std::isfinite(mMinimum) && std::isfinite(mMaximum);
}

float XAUParameterInfo::GetRange() const
{
    const float range = mMaximum - mMinimum;
    return range > 0.0F ? range : 1.0F;
}

float XAUParameterInfo::ToNormalized(float value) const
{
    if (IsWiderThanAFloat())
        return ToFloat((static_cast<double>(value) - mMinimum) / (static_cast<double>(mMaximum) - mMinimum));
    return (value - mMinimum) / GetRange();
}

float XAUParameterInfo::FromNormalized(float normalized) const
{
    if (IsWiderThanAFloat())
        return ToFloat((static_cast<double>(mMaximum) - mMinimum) * normalized + mMinimum);
    return GetRange() * normalized + mMinimum;
}

bool XAUParameterInfo::CanRamp() const
{
    return mCanRamp;
}

bool XAUParameterInfo::CanBeAutomated() const
{
    return (mFlags & kAudioUnitParameterFlag_NonRealTime) == 0;
}

int XAUParameterInfo::GetStepCount() const
{
    return mStepCount;
}

// The unit's text is deliberately not released: units differ in whether they keep it, and one that does would be left
// with a dead string.
UTF16String XAUParameterInfo::GetParameterString(float normalized) const
{
    const AudioUnitParameterValue value = FromNormalized(normalized);
    AudioUnitParameterStringFromValue text = {};
    text.inParamID = mParameterID;
    text.inValue = &value;
    UInt32 size = sizeof(text);
    const OSStatus result = CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_ParameterStringFromValue,
                                                              mScope, 0, &text, &size);
    if (result == noErr)
        return MACtoZEB(text.outString);
    zebcore::utility::oUTF16StringStream stream;
    stream << value;
    return stream.str();
}

} // namespace zebaudiofilterhost::xau
