#include "audiofilter/AudioFilterParameterInfo.h"

namespace zebaudiofilterhost
{

AudioFilterParameterInfo::AudioFilterParameterInfo() : mUnit()
{
}

AudioFilterParameterInfo::AudioFilterParameterInfo(const UTF16String& name, const UTF16String& label,
                                                   AudioFilterParameterInfoUnit unit)
    : mName(name), mLabel(label), mUnit(unit)
{
}

AudioFilterParameterInfo::~AudioFilterParameterInfo() = default;

bool AudioFilterParameterInfo::CanRamp() const
{
    return false;
}

bool AudioFilterParameterInfo::CanBeAutomated() const
{
    return true;
}

bool AudioFilterParameterInfo::SupportsStringForArbitraryValues() const
{
    return true;
}

int AudioFilterParameterInfo::GetStepCount() const
{
    return 0;
}

void AudioFilterParameterInfo::SetName(const UTF16String& name)
{
    mName = name;
}

UTF16String AudioFilterParameterInfo::GetName() const
{
    return mName;
}

void AudioFilterParameterInfo::SetLabel(const UTF16String& label)
{
    mLabel = label;
}

UTF16String AudioFilterParameterInfo::GetLabel() const
{
    return mLabel;
}

bool AudioFilterParameterInfo::IsExposed() const
{
    return mExposed;
}

void AudioFilterParameterInfo::SetExposed(bool exposed)
{
    mExposed = exposed;
}

void AudioFilterParameterInfo::SetUnit(AudioFilterParameterInfoUnit unit)
{
    mUnit = unit;
}

AudioFilterParameterInfoUnit AudioFilterParameterInfo::GetUnit() const
{
    return mUnit;
}

} // namespace zebaudiofilterhost
