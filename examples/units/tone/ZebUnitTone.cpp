// A sine tone: no input, two outputs.

#include "Unit.h"

#include <cmath>

namespace
{

constexpr AudioUnitParameterID kFrequency = 0;
constexpr AudioUnitParameterID kLevel = 1;
constexpr double kPi = 3.14159265358979323846;

class ToneUnit : public zebunits::Unit
{
public:
    explicit ToneUnit(const AudioComponentDescription& component)
        : Unit({.component = component,
                .parameters = {{kFrequency, "Frequency", kAudioUnitParameterUnit_Hertz, 20.0F, 20000.0F, 440.0F},
                               {kLevel, "Level", kAudioUnitParameterUnit_LinearGain, 0.0F, 1.0F, 0.25F}},
                .channels = {{0, 2}},
                .inputs = {}})
    {
    }

    OSStatus Reset() override
    {
        mPhase = 0.0;
        return noErr;
    }

protected:
    void Process(const std::vector<Channels>& /*inputs*/, const Channels& outputs, UInt32 frames) override
    {
        const double step = 2.0 * kPi * static_cast<double>(GetValue(kFrequency)) / GetSampleRate();
        const float level = GetValue(kLevel);
        for (UInt32 frame = 0; frame < frames; ++frame)
        {
            const float sample = level * static_cast<float>(std::sin(mPhase));
            for (float* output : outputs)
                output[frame] = sample;
            mPhase = std::fmod(mPhase + step, 2.0 * kPi);
        }
    }

private:
    double mPhase = 0.0;
};

} // namespace

CF_EXPORT AudioComponentPlugInInterface* ZebUnitToneFactory(const AudioComponentDescription* description)
{
    return zebunits::MakeInterface(std::make_unique<ToneUnit>(*description));
}
