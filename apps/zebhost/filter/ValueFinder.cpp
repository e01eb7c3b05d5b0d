#include "filter/ValueFinder.h"

#include "cli/Failure.h"
#include "filter/NumericRange.h"
#include "filter/Quantity.h"
#include "output/Numbers.h"
#include "output/PrintableText.h"
#include "output/Strings.h"

#include <algorithm>
#include <cmath>

namespace zebhost
{

namespace
{

constexpr const char* kNormalisedDoes =
    "a normalised value does it: --norm NAME=0.5, or norm:0.5 in an automation file";
constexpr int kMostSteps = 65536; // a count that lies must not take for ever

bool IsNumber(const Quantity& shown, const Quantity& wanted)
{
    return shown.value == wanted.value || std::abs(shown.value - wanted.value) <= shown.resolution * 1.000001;
}

bool FitsUnit(const Quantity& shown, const Quantity& wanted)
{
    return wanted.unit.empty() || shown.unit.empty() || shown.unit == wanted.unit;
}

} // namespace

ValueFinder::ValueFinder(const zebaudiofilterhost::AudioFilterParameterInfo& info)
    : mInfo(info), mName(Printable(info.GetName())), mUnit(Printable(info.GetLabel()))
{
    constexpr std::size_t kLongestUnit = 8;
    if (!info.SupportsStringForArbitraryValues() && (mUnit.size() > kLongestUnit || EqualIgnoringCase(mUnit, mName)))
    {
        mLongName = EqualIgnoringCase(mUnit, mName) ? std::string() : mUnit;
        mUnit.clear();
    }
}

ValueFinder::ValueFinder(zebaudiofilterhost::AudioFilter& filter, int index,
                         const zebaudiofilterhost::AudioFilterParameterInfo& info)
    : ValueFinder(info)
{
    mFilter = info.SupportsStringForArbitraryValues() ? nullptr : &filter;
    mIndex = index;
}

ValueFinder::~ValueFinder()
{
    try
    {
        if (mValueBefore)
        {
            mFilter->SetParameter(mIndex, *mValueBefore);
        }
    }
    catch (...)
    {
        // The plug-in took the value a moment ago. Whatever uses the parameter next hears of it.
    }
}

ValueFinder::Found ValueFinder::Find(const std::string& wanted) const
{
    return StepCount() > 0 ? FindStep(wanted) : FindContinuous(wanted);
}

std::string ValueFinder::Text(float value) const
{
    return mFilter == nullptr ? Printable(mInfo.GetParameterString(value)) : CurrentTextAt(value);
}

std::string ValueFinder::CurrentTextAt(float value) const
{
    const float current = mFilter->GetParameter(mIndex);
    if (current != value)
    {
        mValueBefore = mValueBefore.value_or(current);
        mFilter->SetParameter(mIndex, value);
    }
    const zebaudiofilterhost::UTF16String text = mInfo.GetParameterString(value);
    return Printable(text.empty() ? mFilter->GetParameterString(mIndex) : text);
}

std::string ValueFinder::Shown(float value) const
{
    const std::string text = Text(value);
    const bool addUnit = !mUnit.empty() && !text.empty() && !ContainsIgnoringCase(text, mUnit);
    return addUnit ? text + " " + mUnit : text;
}

std::vector<std::string> ValueFinder::StepTexts(int limit) const
{
    std::vector<std::string> texts;
    for (int step = 0; StepCount() > 0 && step <= StepCount() && step < limit; ++step)
    {
        texts.push_back(Shown(StepValue(step)));
    }
    return texts;
}

int ValueFinder::StepCount() const
{
    const int told = mInfo.GetStepCount();
    if (told <= 0 || told >= kMostSteps)
    {
        return 0;
    }
    // Plug-ins that only know their current text tell the width of a step where others tell the number of steps.
    const float range = std::abs(mInfo.FromNormalized(1) - mInfo.FromNormalized(0));
    const bool isWidth = !mInfo.SupportsStringForArbitraryValues() && range > static_cast<float>(told);
    const float count = isWidth ? std::round(range / static_cast<float>(told)) : static_cast<float>(told);
    return count < kMostSteps ? static_cast<int>(count) : 0;
}

float ValueFinder::StepValue(int step) const
{
    return static_cast<float>(step) / static_cast<float>(StepCount());
}

bool ValueFinder::IsText(const std::string& text, const std::string& wanted) const
{
    return EqualIgnoringCase(text, wanted) || EqualIgnoringCase(text + " " + mUnit, wanted) ||
           EqualIgnoringCase(text + mUnit, wanted);
}

ValueFinder::Found ValueFinder::FindStep(const std::string& wanted) const
{
    const std::string trimmed(Trimmed(wanted));
    int step = StepByText(trimmed);
    step = step >= 0 ? step : StepByNumber(trimmed);
    step = step >= 0 ? step : StepByBeginning(trimmed);
    if (step < 0)
    {
        constexpr int kMostTexts = 24;
        Refuse(wanted,
               "it can be " + Joined(StepTexts(kMostTexts), ", ") + (StepCount() >= kMostTexts ? ", ..." : ""));
    }
    return {StepValue(step), Shown(StepValue(step)), true};
}

int ValueFinder::StepByText(const std::string& wanted) const
{
    int folded = -1;
    for (int step = 0; step <= StepCount(); ++step)
    {
        const std::string text = Text(StepValue(step));
        if (text == wanted)
        {
            return step;
        }
        folded = folded < 0 && IsText(text, wanted) ? step : folded;
    }
    return folded;
}

int ValueFinder::StepByNumber(const std::string& wanted) const
{
    const std::optional<Quantity> number = ParseQuantity(wanted, mUnit);
    for (int step = 0; number && step <= StepCount(); ++step)
    {
        const std::optional<Quantity> shown = ParseQuantity(Text(StepValue(step)), mUnit);
        if (shown && FitsUnit(*shown, *number) && std::abs(shown->value - number->value) <= 1e-9)
        {
            return step;
        }
    }
    return -1;
}

int ValueFinder::StepByBeginning(const std::string& wanted) const
{
    int found = -1;
    for (int step = 0; !wanted.empty() && step <= StepCount(); ++step)
    {
        if (StartsWithIgnoringCase(Text(StepValue(step)), wanted))
        {
            if (found >= 0)
            {
                return -1;
            }
            found = step;
        }
    }
    return found;
}

ValueFinder::Found ValueFinder::FindContinuous(const std::string& wanted) const
{
    constexpr int kSamples = 1000;
    const std::optional<Quantity> number = ParseQuantity(wanted, mUnit);
    if (!number || std::isinf(number->value))
    {
        for (int sample = 0; sample <= kSamples; ++sample)
        {
            const float value = static_cast<float>(sample) / kSamples;
            if (IsText(Text(value), std::string(Trimmed(wanted))))
            {
                return {value, Shown(value), true};
            }
        }
        Refuse(wanted, "it goes from " + Shown(0) + " to " + Shown(1) + "; " + kNormalisedDoes);
    }
    const std::optional<Quantity> typed = ParseQuantity(wanted, {});
    const float direct = mInfo.ToNormalized(static_cast<float>(typed->value));
    const std::optional<Quantity> directShown = ParseQuantity(Text(direct), mUnit);
    if (direct >= 0 && direct <= 1 && directShown && IsNumber(*directShown, *number))
    {
        return {direct, Shown(direct), true};
    }
    const NumericRange range([this](double value) { return ParseQuantity(Text(static_cast<float>(value)), mUnit); });
    if (!range.IsMonotone())
    {
        Refuse(wanted, std::string("what it displays cannot be searched for that; ") + kNormalisedDoes);
    }
    const auto located = static_cast<float>(range.Locate(number->value));
    const std::optional<Quantity> shown = ParseQuantity(Text(located), mUnit);
    const bool exact = shown && IsNumber(*shown, *number);
    if (!exact && (number->value < range.Lowest() || number->value > range.Highest()))
    {
        Refuse(wanted, "it goes from " + Shown(0) + " to " + Shown(1));
    }
    return {located, Shown(located), exact};
}

void ValueFinder::Refuse(const std::string& wanted, const std::string& possible) const
{
    throw Failure(ExitCode::Usage, "parameter " + mName + " cannot be set to '" + wanted + "': " + possible);
}

} // namespace zebhost
