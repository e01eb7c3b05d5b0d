// The ready-made parameter description.
#pragma once

#include "audiofilter/AudioFilterParameterInfo.h"

namespace zebaudiofilterhost
{

/// A parameter with a linear or logarithmic range. Nothing clamps and no bound is checked. [main]
class ZEB_EXPORT GenericParameterInfo : public AudioFilterParameterInfo
{
public:
    /// lo: value at normalised 0. hi: linear, the value at normalised 1; logarithmic, the natural logarithm of the
    /// ratio of top to bottom, so that the top is lo * exp(hi). A parameter that can't be automated starts hidden.
    /// firstCount goes to the number formatter; secondCount is kept and not read.
    GenericParameterInfo(const UTF16String& name, const UTF16String& label, AudioFilterParameterInfoUnit unit,
                         int index, float lo, float hi, bool canBeAutomated, bool logarithmic,
                         unsigned long firstCount, unsigned long secondCount);

    ~GenericParameterInfo() override;

    float ToNormalized(float value) const override;
    float FromNormalized(float normalized) const override;
    bool CanBeAutomated() const override;
    UTF16String GetParameterString(float normalized) const override;

    /// Both store what they are given, in the meaning of the constructor.
    void SetLoBound(float lo);
    void SetHiBound(float hi);
    float GetLoBound() const;
    float GetHiBound() const;

private:
    UTF16String DecimalText(float normalized) const;

    int mIndex;
    float mLoBound;
    float mHiBound;
    bool mCanBeAutomated;
    bool mLogarithmic;
    unsigned long mFirstCount;
    unsigned long mSecondCount;
};

} // namespace zebaudiofilterhost
