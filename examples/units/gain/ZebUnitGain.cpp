// A gain in decibels. One channel count on both sides, whichever it is.

#include "Unit.h"

#include <cmath>

namespace
{

constexpr AudioUnitParameterID kGain = 0;
constexpr AudioUnitParameterID kMute = 1;

class GainUnit : public zebunits::Unit
{
public:
    explicit GainUnit(const AudioComponentDescription& component)
        : Unit({.component = component,
                .parameters = {{kGain, "Gain", kAudioUnitParameterUnit_Decibels, -96.0F, 12.0F, 0.0F},
                               {kMute, "Mute", kAudioUnitParameterUnit_Boolean, 0.0F, 1.0F, 0.0F}},
                .presets = {{"Unity", {{kGain, 0.0F}, {kMute, 0.0F}}}, {"Half", {{kGain, -6.0206F}}}}})
    {
    }

protected:
    void Process(const std::vector<Channels>& inputs, const Channels& outputs, UInt32 frames) override
    {
        const float factor = GetValue(kMute) >= 0.5F ? 0.0F : std::pow(10.0F, GetValue(kGain) / 20.0F);
        for (std::size_t channel = 0; channel < outputs.size(); ++channel)
        {
            for (UInt32 frame = 0; frame < frames; ++frame)
                outputs[channel][frame] = inputs[0][channel][frame] * factor;
        }
    }
};

} // namespace

CF_EXPORT AudioComponentPlugInInterface* ZebUnitGainFactory(const AudioComponentDescription* description)
{
    return zebunits::MakeInterface(std::make_unique<GainUnit>(*description));
}
