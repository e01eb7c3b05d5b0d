#include "examples/effects/gain/GainProcessor.h"

#include "examples/effects/support/ParameterPoints.h"

#include <algorithm>
#include <cmath>

namespace effects::gain
{

GainProcessor::GainProcessor()
    : Processor(BusSet({{u"Input", SpeakerArr::kStereo}}, {{u"Output", SpeakerArr::kStereo}}))
{
}

bool GainProcessor::Supports(SpeakerArrangement arrangement) const
{
    return Processor::Supports(arrangement) || arrangement == SpeakerArr::k51;
}

tresult PLUGIN_API GainProcessor::getControllerClassId(TUID classID)
{
    kControllerID.toTUID(classID);
    return kResultOk;
}

tresult PLUGIN_API GainProcessor::setActive(TBool state)
{
    const int32 channels = state != 0 ? ChannelCount(mBuses.Arrangement(kOutput, 0)) : 0;
    Send(mHost, kFormatMessage, [=](IAttributeList& attributes) { attributes.setInt(kChannelsAttribute, channels); });
    return kResultOk;
}

float GainProcessor::CurrentGain() const
{
    if (mParameters.Get(kBypass) >= 0.5)
        return 1.0F;
    const double normalized = mParameters.Get(kGain);
    return normalized <= 0.0 ? 0.0F : static_cast<float>(std::pow(10.0, mParameters.Plain(kGain) / 20.0));
}

tresult PLUGIN_API GainProcessor::process(ProcessData& data)
{
    const auto apply = [this](ParamID id, ParamValue value)
    {
        mParameters.Set(id, value);
    };
    if (data.numInputs < 1 || data.numOutputs < 1)
    {
        ProcessInStretches(data, apply, [](int32, int32) {});
        return kResultOk;
    }
    bool silent = true;
    ProcessInStretches(data, apply, [&](int32 first, int32 count) { Render(data, first, count, silent); });

    // A channel is silent if it came in so, or if all of the block was multiplied by zero.
    const uint64 all = (uint64{1} << data.outputs[0].numChannels) - 1;
    data.outputs[0].silenceFlags = silent ? all : data.inputs[0].silenceFlags & all;
    return kResultOk;
}

void GainProcessor::Render(ProcessData& data, int32 first, int32 count, bool& silent) const
{
    const float gain = CurrentGain();
    silent = silent && gain == 0.0F;
    const int32 channels = std::min(data.inputs[0].numChannels, data.outputs[0].numChannels);
    for (int32 channel = 0; channel < channels; ++channel)
    {
        const float* in = data.inputs[0].channelBuffers32[channel] + first;
        float* out = data.outputs[0].channelBuffers32[channel] + first;
        std::transform(in, in + count, out, [gain](float sample) { return sample * gain; });
    }
}

} // namespace effects::gain
