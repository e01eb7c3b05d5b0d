#include "audiofilter/GenericParameterInfo.h"

#include "foundation/zebaudiodsp/ScalarMath.h"
#include "foundation/zebcore/Localizer.h"
#include "foundation/zebcore/NumberToString.h"
#include "foundation/zebcore/StringConversion.h"

#include <array>
#include <charconv>
#include <cmath>
#include <limits>

namespace zebaudiofilterhost
{

namespace
{

constexpr int kUnit_OnOff = 3;
constexpr int kUnit_Integer = 6;
constexpr int kMaximumTextLength = 31;

unsigned long DecimalsFor(float magnitude)
{
    if (magnitude > 100.0F)
        return 0;
    if (magnitude > 10.0F)
        return 1;
    if (magnitude > 1.0F)
        return 2;
    return magnitude > 0.1F ? 3 : 4;
}

UTF16String OnOffText(float normalized)
{
    return zebcore::config::Localizer::Get().Localize(normalized >= 0.5F
                                                          ? "$$$/zebaudiofilterhost/ParameterInfo/On=On"
                                                          : "$$$/zebaudiofilterhost/ParameterInfo/Off=Off");
}

// Bounds are unchecked, so the value may be anything, NaN included.
int Truncate(float value)
{
    constexpr float kBeyond = 2147483648.0F;
    if (std::isnan(value))
        return 0;
    if (value >= kBeyond)
        return std::numeric_limits<int>::max();
    return value < -kBeyond ? std::numeric_limits<int>::min() : static_cast<int>(value);
}

UTF16String IntegerText(float value)
{
    std::array<char, 16> text{};
    const char* end = std::to_chars(text.data(), text.data() + text.size(), Truncate(value)).ptr;
    return zebcore::utility::AsciiToUTF16(text.data(), static_cast<std::size_t>(end - text.data()));
}

} // namespace

GenericParameterInfo::GenericParameterInfo(const UTF16String& name, const UTF16String& label,
                                           AudioFilterParameterInfoUnit unit, int index, float lo, float hi,
                                           bool canBeAutomated, bool logarithmic, unsigned long firstCount,
                                           unsigned long secondCount)
    : AudioFilterParameterInfo(name, label, unit)
    , mIndex(index)
    , mLoBound(lo)
    , mHiBound(hi)
    , mCanBeAutomated(canBeAutomated)
    , mLogarithmic(logarithmic)
    , mFirstCount(firstCount)
    , mSecondCount(secondCount)
{
    if (!mCanBeAutomated)
        SetExposed(false);
}

GenericParameterInfo::~GenericParameterInfo() = default;

float GenericParameterInfo::ToNormalized(float value) const
{
    if (mLogarithmic)
        return zebaudiodsp::logf(value / mLoBound) / mHiBound;
    return (value - mLoBound) / (mHiBound - mLoBound);
}

float GenericParameterInfo::FromNormalized(float normalized) const
{
    if (mLogarithmic)
        return zebaudiodsp::expf(mHiBound * normalized) * mLoBound;
    return (mHiBound - mLoBound) * normalized + mLoBound;
}

bool GenericParameterInfo::CanBeAutomated() const
{
    return mCanBeAutomated;
}

UTF16String GenericParameterInfo::GetParameterString(float normalized) const
{
    switch (static_cast<int>(GetUnit()))
    {
    case 0:
    case 1:
    case 2:
    case 4:
    case 5:
        return DecimalText(normalized);
    case kUnit_OnOff:
        return OnOffText(normalized);
    case kUnit_Integer:
        return IntegerText(FromNormalized(normalized));
    default:
        return {};
    }
}

UTF16String GenericParameterInfo::DecimalText(float normalized) const
{
    const float value = FromNormalized(normalized);
    return zebcore::utility::NumberToString(static_cast<double>(value), mFirstCount, DecimalsFor(std::abs(value)),
                                            zebcore::utility::Flags<unsigned short>(), kMaximumTextLength);
}

void GenericParameterInfo::SetLoBound(float lo)
{
    mLoBound = lo;
}

void GenericParameterInfo::SetHiBound(float hi)
{
    mHiBound = hi;
}

float GenericParameterInfo::GetLoBound() const
{
    return mLoBound;
}

float GenericParameterInfo::GetHiBound() const
{
    return mHiBound;
}

} // namespace zebaudiofilterhost
