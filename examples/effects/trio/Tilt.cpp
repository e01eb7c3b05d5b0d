#include "examples/effects/trio/Tilt.h"

#include "examples/effects/support/ParameterPoints.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace effects::trio
{

namespace
{

constexpr ParamID kTilt = 0; // dB by which the highs are raised and the lows lowered

constexpr double kMiddleFrequency = 800.0;

ParameterSet MakeParameters()
{
    return {{.id = kTilt, .title = u"Tilt", .units = u"dB", .minimum = -12.0, .maximum = 12.0, .initial = 0.0}};
}

} // namespace

Tilt::Tilt()
    : SingleComponent(MakeParameters(), BusSet({{u"Input", SpeakerArr::kStereo}}, {{u"Output", SpeakerArr::kStereo}}))
{
}

tresult PLUGIN_API Tilt::setActive(TBool)
{
    mLow = {};
    return kResultOk;
}

tresult PLUGIN_API Tilt::process(ProcessData& data)
{
    ProcessInStretches(
        data, [this](ParamID id, ParamValue value) { mParameters.Set(id, value); },
        [&](int32 first, int32 count)
        {
            if (data.numInputs > 0 && data.numOutputs > 0)
                Render(data, first, count);
        });
    return kResultOk;
}

void Tilt::Render(ProcessData& data, int32 first, int32 count)
{
    const double turn = 2.0 * std::numbers::pi * kMiddleFrequency / mSetup.sampleRate;
    const auto follow = static_cast<float>(1.0 - std::exp(-turn));
    const auto high = static_cast<float>(std::pow(10.0, mParameters.Plain(kTilt) / 20.0));
    const int32 channels = std::min({data.inputs[0].numChannels, data.outputs[0].numChannels, int32{2}});
    for (int32 channel = 0; channel < channels; ++channel)
    {
        const float* in = data.inputs[0].channelBuffers32[channel];
        float* out = data.outputs[0].channelBuffers32[channel];
        float& low = mLow[static_cast<std::size_t>(channel)];
        for (int32 i = first; i < first + count; ++i)
        {
            const float sample = in[i];
            low += (sample - low) * follow;
            out[i] = low / high + (sample - low) * high;
        }
    }
}

} // namespace effects::trio
