#pragma once

#include "audiofilter/AudioFilterParameterInfo.h"
#include "host/src/VST/src/VSTDispatcherBase.h"

namespace zebaudiofilterhost::vst
{

/// One parameter of a plug-in, which must outlive it.
class VSTParameterInfo : public AudioFilterParameterInfo, public VSTDispatcherBase
{
public:
    /// Asks the plug-in for the names and the range of the parameter. Raises a contract violation without a plug-in;
    /// one that throws has no more to tell. [main]
    VSTParameterInfo(AEffect* inAEffect, int index);
    ~VSTParameterInfo() override;

    float ToNormalized(float value) const override;
    float FromNormalized(float normalized) const override;
    bool CanRamp() const override;
    bool CanBeAutomated() const override;
    bool SupportsStringForArbitraryValues() const override;

    /// The text of the parameter's current value, whatever the argument: plug-ins know no other. [main]
    UTF16String GetParameterString(float normalized) const override;
    int GetStepCount() const override;

private:
    int mIndex;
    float mOffset = 0.0F; // the value at normalised 0
    float mScale = 1.0F;  // normalised per unit of the value
    int mStepCount = 0;
};

} // namespace zebaudiofilterhost::vst
