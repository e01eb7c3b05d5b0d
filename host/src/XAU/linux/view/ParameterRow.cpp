#include "host/src/XAU/linux/view/ParameterRow.h"

#include "foundation/zebcore/StringConversion.h"
#include "host/src/XAU/src/CFOwner.h"
#include "host/src/XAU/src/CallGuarded.h"
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

constexpr UInt32 kMaxRows = 32768;
constexpr double kMaxNames = 64.0; // of steps: the unit is asked for each
constexpr std::size_t kMaxText = 256;

constexpr char16_t kReplacement = 0xFFFD;

bool IsControl(char32_t point)
{
    return point < 0x20 || (point >= 0x7F && point < 0xA0);
}

// Cairo draws nothing any more once it has met another one.
bool IsCharacter(char32_t point)
{
    const bool isSurrogate = point >= 0xD800 && point < 0xE000;
    return !isSurrogate && (point & 0xFFFE) != 0xFFFE && (point < 0xFDD0 || point > 0xFDEF);
}

// The character that begins there, or half of one.
char32_t PointAt(const UTF16String& text, std::size_t index)
{
    const char32_t first = text[index];
    const char32_t second = index + 1 < text.size() ? text[index + 1] : 0;
    const bool isPair = first >= 0xD800 && first < 0xDC00 && second >= 0xDC00 && second < 0xE000;
    return isPair ? 0x10000 + ((first - 0xD800) << 10) + (second - 0xDC00) : first;
}

// Null if it is of another kind, as a unit's answer can be.
template <typename Ref>
Ref ToKind(CFTypeRef object, CFTypeID kind)
{
    return object && CFGetTypeID(object) == kind ? static_cast<Ref>(object) : nullptr;
}

} // namespace

std::string ToShownText(const UTF16String& text)
{
    UTF16String shown;
    for (std::size_t index = 0; index < text.size() && shown.size() < kMaxText;)
    {
        const char32_t point = PointAt(text, index);
        const std::size_t units = point > 0xFFFF ? 2 : 1;
        if (IsControl(point))
            shown += u' ';
        else if (IsCharacter(point))
            shown.append(text, index, units);
        else
            shown += kReplacement;
        index += units;
    }
    const UTF8String bytes = zebcore::utility::UTF16to8(shown);
    return {bytes.begin(), bytes.end()};
}

ParameterRow::ParameterRow(AudioUnit unit, AudioUnitScope scope, AudioUnitParameterID id)
    : mUnit(unit), mScope(scope), mID(id)
{
    const boost::intrusive_ptr<XAUParameterInfo> names(new XAUParameterInfo(unit, scope, id));
    mName = ToShownText(names->GetName());
    mLabel = ToShownText(names->GetLabel());
    const ParameterRecord record(unit, scope, id);
    const AudioUnitParameterInfo& info = record.mInfo;
    mMinimum = static_cast<double>(info.minValue);
    mMaximum = static_cast<double>(info.maxValue);
    mDefault = static_cast<double>(info.defaultValue);
    mIsNonRealTime = (info.flags & kAudioUnitParameterFlag_NonRealTime) != 0;
    mIsSwitch = info.unit == kAudioUnitParameterUnit_Boolean;
    if (mIsSwitch)
        mControl = Control::Switch;
    else if (info.unit == kAudioUnitParameterUnit_Indexed)
        ReadSteps();
    const bool isOnlyToBeWatched = (info.flags & kAudioUnitParameterFlag_IsWritable) == 0 ||
                                   (info.flags & kAudioUnitParameterFlag_MeterReadOnly) != 0;
    if (isOnlyToBeWatched)
        mControl = mControl == Control::Slider ? Control::Level : Control::None;
    Refresh();
}

void ParameterRow::ReadSteps()
{
    const double steps = std::floor(mMaximum - mMinimum) + 1.0;
    if (!(steps >= 2.0))
        return;
    mControl = Control::Steps;
    mIsStepped = true;
    if (steps > kMaxNames)
        return;
    CFTypeRef answer = nullptr;
    UInt32 size = sizeof(answer);
    const OSStatus result = CallGuarded<AudioUnitGetProperty>(mUnit, kAudioUnitProperty_ParameterValueStrings, mScope,
                                                              mID, &answer, &size);
    const CFOwner owner(result == noErr ? answer : nullptr);
    const auto* names = ToKind<CFArrayRef>(owner.get(), CFArrayGetTypeID());
    const CFIndex count = names ? CFArrayGetCount(names) : 0;
    for (std::size_t step = 0; step < static_cast<std::size_t>(steps); ++step)
    {
        const auto index = static_cast<CFIndex>(step);
        const void* item = index < count ? CFArrayGetValueAtIndex(names, index) : nullptr;
        if (const auto* name = ToKind<CFStringRef>(item, CFStringGetTypeID()))
            mStepNames.push_back(ToShownText(MACtoZEB(name)));
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
    const OSStatus result = CallGuarded<AudioUnitGetProperty>(mUnit, kAudioUnitProperty_ParameterStringFromValue,
                                                              mScope, 0, &request, &size);
    if (result == noErr)
        return ToShownText(MACtoZEB(request.outString)); // not released, as everywhere: units differ in whose it is
    return MakeText(static_cast<double>(value));
}

// For a value of which the unit has no text.
std::string ParameterRow::MakeText(double value) const
{
    const double step = std::round(value - mMinimum);
    if (step >= 0.0 && step < static_cast<double>(mStepNames.size()))
        return mStepNames[static_cast<std::size_t>(step)];
    if (mIsSwitch)
        return value >= (mMinimum + mMaximum) / 2.0 ? "On" : "Off";
    std::array<char, 48> text = {};
    std::snprintf(text.data(), text.size(), mIsStepped ? "%.0f" : "%.2f", value);
    return text.data();
}

bool ParameterRow::Refresh()
{
    AudioUnitParameterValue value = 0.0F;
    if (CallGuarded<AudioUnitGetParameter>(mUnit, mID, mScope, 0, &value) != noErr)
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
    CallGuarded<AUParameterSet>(nullptr, nullptr, &parameter, static_cast<AudioUnitParameterValue>(value), 0);
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

std::vector<AudioUnitParameterID> ReadParameterIDs(AudioUnit unit)
{
    const auto read = [unit](void* data, UInt32& size)
    {
        return CallGuarded<AudioUnitGetProperty>(unit, kAudioUnitProperty_ParameterList, kAudioUnitScope_Global, 0,
                                                 data, &size);
    };
    UInt32 size = 0;
    if (read(nullptr, size) != noErr)
        return {};
    const UInt32 count = std::min(static_cast<UInt32>(size / sizeof(AudioUnitParameterID)), kMaxRows);
    const auto announced = static_cast<UInt32>(count * sizeof(AudioUnitParameterID));
    std::vector<AudioUnitParameterID> ids(std::max<std::size_t>(count, 1)); // null would ask for the size
    size = announced;
    if (read(ids.data(), size) != noErr)
        return {};
    ids.resize(std::min(size, announced) / sizeof(AudioUnitParameterID));
    return ids;
}

} // namespace zebaudiofilterhost::xau
