#include "host/src/VST3/src/VST3ParameterInfo.h"

#include "host/src/VST3/src/PluginText.h"

namespace zebaudiofilterhost::vst3
{

using Steinberg::Vst::IEditController;
using Steinberg::Vst::ParameterInfo;

namespace
{

// Stays empty if the controller fails to tell.
ParameterInfo ReadInfo(IEditController& controller, int index)
{
    ParameterInfo info = {};
    controller.getParameterInfo(index, info);
    return info;
}

} // namespace

VST3ParameterInfo::VST3ParameterInfo(IEditController* controller, int index)
    : VST3ParameterInfo(controller, index, ReadInfo(*controller, index))
{
}

VST3ParameterInfo::VST3ParameterInfo(IEditController* controller, int index, const ParameterInfo& texts)
    : AudioFilterParameterInfo(UTF16String(BoundedText(texts.title)), UTF16String(BoundedText(texts.units)),
                               AudioFilterParameterInfoUnit())
    , mController(PluginPtr<IEditController>::Query(controller))
    , mIndex(index)
{
    const ParameterInfo info = ReadInfo(*controller, index);
    mParameterID = info.id;
    mFlags = info.flags;
    mStepCount = info.stepCount;
    SetExposed((mFlags & ParameterInfo::kCanAutomate) != 0);
}

VST3ParameterInfo::~VST3ParameterInfo() = default;

float VST3ParameterInfo::ToNormalized(float plain) const
{
    if (!mController)
        return 0.0F;
    return static_cast<float>(mController->plainParamToNormalized(mParameterID, static_cast<double>(plain)));
}

float VST3ParameterInfo::FromNormalized(float normalized) const
{
    if (!mController)
        return 0.0F;
    return static_cast<float>(mController->normalizedParamToPlain(mParameterID, static_cast<double>(normalized)));
}

bool VST3ParameterInfo::CanRamp() const
{
    return true;
}

bool VST3ParameterInfo::CanBeAutomated() const
{
    return (mFlags & ParameterInfo::kCanAutomate) != 0;
}

bool VST3ParameterInfo::SupportsStringForArbitraryValues() const
{
    return true;
}

UTF16String VST3ParameterInfo::GetParameterString(float normalized) const
{
    if (!mController)
        return {};
    Steinberg::Vst::String128 text = {};
    mController->getParamStringByValue(mParameterID, static_cast<double>(normalized), text);
    return UTF16String(BoundedText(text));
}

int VST3ParameterInfo::GetStepCount() const
{
    return mStepCount;
}

} // namespace zebaudiofilterhost::vst3
