#include "host/src/XAU/linux/view/ParameterRow.h"

#include "foundation/zebcore/StringConversion.h"
#include "host/src/XAU/src/CFOwner.h"
#include "host/src/XAU/src/XAUParameterInfo.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>

namespace zebaudiofilterhost::xau
{

namespace
{

constexpr UInt32 kMaxRows = 512;   // a longer window could not be shown anyway
constexpr double kMaxNames = 64.0; // of steps: the unit is asked for each

std::string ToNarrow(const UTF16String& text)
{
    const UTF8String bytes = zebcore::utility::UTF16to8(text);
    std::string narrow(bytes.begin(), bytes.end());
    std::replace_if(
        narrow.begin(), narrow.end(), [](char unit) { return unit >= '\0' && unit < ' '; }, ' ');
    return narrow;
}

} // namespace

ParameterRow::ParameterRow(AudioUnit unit, AudioUnitScope scope, AudioUnitParameterID id)
    : mUnit(unit), mScope(scope), mID(id)
{
    const boost::intrusive_ptr<XAUParameterInfo> names(new XAUParameterInfo(unit, scope, id));
    mName = ToNarrow(names->GetName());
    mLabel = ToNarrow(names->GetLabel());
    const ParameterRecord record(unit, scope, id);
    const AudioUnitParameterInfo& info = record.mInfo;
    mMinimum = static_cast<double>(info.minValue);
    mMaximum = static_cast<double>(info.maxValue);
    mDefault = static_cast<double>(info.defaultValue);
    mIsWritable = (info.flags & kAudioUnitParameterFlag_IsWritable) != 0;
    if (info.unit == kAudioUnitParameterUnit_Boolean)
        mControl = Control::Switch;
    else if (info.unit == kAudioUnitParameterUnit_Indexed)
        ReadSteps();
    Refresh();
}

void ParameterRow::ReadSteps()
{
    const double steps = std::floor(mMaximum - mMinimum) + 1.0;
    if (!(steps >= 2.0))
        return;
    mControl = Control::Steps;
    if (steps > kMaxNames)
        return;
    CFArrayRef names = nullptr;
    UInt32 size = sizeof(CFTypeRef);
    const bool hasNames =
        AudioUnitGetProperty(mUnit, kAudioUnitProperty_ParameterValueStrings, mScope, mID, &names, &size) == noErr &&
        names != nullptr;
    const CFOwner owner(hasNames ? names : nullptr);
    for (std::size_t step = 0; step < static_cast<std::size_t>(steps); ++step)
    {
        const auto index = static_cast<CFIndex>(step);
        if (hasNames && index < CFArrayGetCount(names))
            mStepNames.push_back(ToNarrow(MACtoZEB(static_cast<CFStringRef>(CFArrayGetValueAtIndex(names, index)))));
        else
            mStepNames.push_back(
                ReadText(static_cast<AudioUnitParameterValue>(mMinimum + static_cast<double>(step))));
    }
}

std::string ParameterRow::ReadText(AudioUnitParameterValue value) const
{
    AudioUnitParameterStringFromValue request = {};
    request.inParamID = mID;
    request.inValue = &value;
    UInt32 size = sizeof(request);
    if (AudioUnitGetProperty(mUnit, kAudioUnitProperty_ParameterStringFromValue, mScope, 0, &request, &size) == noErr)
        return ToNarrow(MACtoZEB(request.outString)); // not released, as everywhere: units differ in whose it is
    return MakeText(static_cast<double>(value));
}

// For a value of which the unit has no text.
std::string ParameterRow::MakeText(double value) const
{
    const double step = std::round(value - mMinimum);
    if (step >= 0.0 && step < static_cast<double>(mStepNames.size()))
        return mStepNames[static_cast<std::size_t>(step)];
    std::array<char, 48> text = {};
    std::snprintf(text.data(), text.size(), mControl == Control::Steps ? "%.0f" : "%.2f", value);
    return text.data();
}

bool ParameterRow::Refresh()
{
    AudioUnitParameterValue value = 0.0F;
    if (AudioUnitGetParameter(mUnit, mID, mScope, 0, &value) != noErr)
        return false;
    const double range = mMaximum > mMinimum ? mMaximum - mMinimum : 1.0;
    const double position = std::clamp((static_cast<double>(value) - mMinimum) / range, 0.0, 1.0);
    std::string text = ReadText(value);
    if (!mLabel.empty())
        text += " " + mLabel;
    const bool hasChanged = position != mPosition || text != mText;
    mPosition = position;
    mText = std::move(text);
    return hasChanged;
}

std::size_t ParameterRow::GetStep() const
{
    const auto last = static_cast<double>(std::max<std::size_t>(mStepNames.size(), 1) - 1);
    return static_cast<std::size_t>(std::lround(mPosition * last));
}

void ParameterRow::SetValue(double value)
{
    const AudioUnitParameter parameter = GetParameter();
    AUParameterSet(nullptr, nullptr, &parameter, static_cast<AudioUnitParameterValue>(value), 0);
    Refresh();
}

void ParameterRow::SetPosition(double position)
{
    const double value = mMinimum + std::clamp(position, 0.0, 1.0) * (mMaximum - mMinimum);
    SetValue(mControl == Control::Slider ? value : std::round(value));
}

void ParameterRow::SetDefault()
{
    SetValue(std::clamp(mDefault, mMinimum, std::max(mMinimum, mMaximum)));
}

void ParameterRow::Notify(AudioUnitEventType gesture) const
{
    AudioUnitEvent event = {};
    event.mEventType = gesture;
    event.mArgument.mParameter = GetParameter();
    AUEventListenerNotify(nullptr, nullptr, &event);
}

std::vector<ParameterRow> ReadParameterRows(AudioUnit unit)
{
    UInt32 size = 0;
    std::vector<ParameterRow> rows;
    if (AudioUnitGetProperty(unit, kAudioUnitProperty_ParameterList, kAudioUnitScope_Global, 0, nullptr, &size) !=
        noErr)
        return rows;
    std::vector<AudioUnitParameterID> ids(std::clamp<std::size_t>(size / sizeof(AudioUnitParameterID), 1, kMaxRows));
    const auto announced = std::min(size, static_cast<UInt32>(ids.size() * sizeof(AudioUnitParameterID)));
    size = announced;
    if (AudioUnitGetProperty(unit, kAudioUnitProperty_ParameterList, kAudioUnitScope_Global, 0, ids.data(), &size) !=
        noErr)
        return rows;
    ids.resize(std::min(size, announced) / sizeof(AudioUnitParameterID));
    for (const AudioUnitParameterID id : ids)
        rows.emplace_back(unit, kAudioUnitScope_Global, id);
    return rows;
}

} // namespace zebaudiofilterhost::xau
