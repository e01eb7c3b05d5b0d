#pragma once

#include "audiofilter/AudioFilterParameterInfo.h"
#include "host/src/VST3/src/PluginPtr.h"

#include <pluginterfaces/vst/ivsteditcontroller.h>

#include <cstdint>

namespace zebaudiofilterhost::vst3
{

/// One parameter of a controller. Holds a reference on the controller.
class VST3ParameterInfo : public AudioFilterParameterInfo
{
public:
    /// Reads the parameter at `index` of the controller's list. A controller that fails to tell gives empty texts and
    /// the ID 0. `controller` must not be null. [main]
    VST3ParameterInfo(Steinberg::Vst::IEditController* controller, int index);
    ~VST3ParameterInfo() override;

    float ToNormalized(float plain) const override;
    float FromNormalized(float normalized) const override;
    bool CanRamp() const override;
    bool CanBeAutomated() const override;
    bool SupportsStringForArbitraryValues() const override;
    UTF16String GetParameterString(float normalized) const override;
    int GetStepCount() const override;

    /// The plug-in's own number of the parameter. [any]
    std::uint32_t GetParameterID() const { return mParameterID; }

    /// The parameter's place in the controller's list. [any]
    std::int32_t GetControllerIndex() const { return mIndex; }

private:
    VST3ParameterInfo(Steinberg::Vst::IEditController* controller, int index,
                      const Steinberg::Vst::ParameterInfo& texts);

    PluginPtr<Steinberg::Vst::IEditController> mController;
    std::uint32_t mParameterID = 0;
    std::int32_t mIndex;
    std::int32_t mFlags = 0;
    std::int32_t mStepCount = 0;
};

} // namespace zebaudiofilterhost::vst3
