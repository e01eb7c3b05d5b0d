// Two inputs, each with a level, into one output. Inputs and output may have any number of channels.

#include "Unit.h"

namespace
{

constexpr AudioUnitParameterID kLevelA = 0;
constexpr AudioUnitParameterID kLevelB = 1;

class MixerUnit : public zebunits::Unit
{
public:
    explicit MixerUnit(const AudioComponentDescription& component)
        : Unit({.component = component,
                .parameters = {{kLevelA, "Level A", kAudioUnitParameterUnit_LinearGain, 0.0F, 2.0F, 1.0F},
                               {kLevelB, "Level B", kAudioUnitParameterUnit_LinearGain, 0.0F, 2.0F, 1.0F}},
                .channels = {{-1, -2}},
                .inputs = {"Voice", "Music"}})
    {
    }

protected:
    void Process(const std::vector<Channels>& inputs, const Channels& outputs, UInt32 frames) override
    {
        const float levelA = GetValue(kLevelA);
        const float levelB = GetValue(kLevelB);
        for (std::size_t channel = 0; channel < outputs.size(); ++channel)
        {
            for (UInt32 frame = 0; frame < frames; ++frame)
                outputs[channel][frame] =
                    levelA * Sample(inputs[0], channel, frame) + levelB * Sample(inputs[1], channel, frame);
        }
    }

private:
    // A single channel is heard everywhere.
    static float Sample(const Channels& input, std::size_t channel, UInt32 frame)
    {
        if (input.size() == 1)
            return input[0][frame];
        return channel < input.size() ? input[channel][frame] : 0.0F;
    }
};

} // namespace

CF_EXPORT AudioComponentPlugInInterface* ZebUnitMixerFactory(const AudioComponentDescription* description)
{
    return zebunits::MakeInterface(std::make_unique<MixerUnit>(*description));
}
