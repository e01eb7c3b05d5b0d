#include "examples/effects/view/BalanceProcessor.h"

#include "examples/effects/support/ParameterPoints.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace effects::balance
{

BalanceProcessor::BalanceProcessor()
    : Processor(BusSet({{u"Input", SpeakerArr::kStereo}}, {{u"Output", SpeakerArr::kStereo}}))
{
}

tresult PLUGIN_API BalanceProcessor::getControllerClassId(TUID classID)
{
    kControllerID.toTUID(classID);
    return kResultOk;
}

tresult PLUGIN_API BalanceProcessor::process(ProcessData& data)
{
    float peak = 0.0F;
    ProcessInStretches(
        data, [this](ParamID id, ParamValue value) { mParameters.Set(id, value); },
        [&](int32 first, int32 count)
        {
            if (data.numInputs > 0 && data.numOutputs > 0)
                peak = std::max(peak, Render(data, first, count));
        });
    if (data.numSamples > 0)
        ReportLevel(data, peak);
    return kResultOk;
}

// Gives the peak of what it wrote.
float BalanceProcessor::Render(ProcessData& data, int32 first, int32 count) const
{
    const auto balance = static_cast<float>(mParameters.Plain(kBalance) / 100.0);
    const std::array<float, 2> gains{std::min(1.0F, 1.0F - balance), std::min(1.0F, 1.0F + balance)};
    float peak = 0.0F;
    for (int32 channel = 0; channel < std::min(data.outputs[0].numChannels, int32{2}); ++channel)
    {
        const float* in = data.inputs[0].channelBuffers32[channel];
        float* out = data.outputs[0].channelBuffers32[channel];
        for (int32 i = first; i < first + count; ++i)
        {
            out[i] = in[i] * gains[static_cast<std::size_t>(channel)];
            peak = std::max(peak, std::abs(out[i]));
        }
    }
    return peak;
}

void BalanceProcessor::ReportLevel(ProcessData& data, float peak)
{
    if (data.outputParameterChanges == nullptr || peak == mReported)
        return;
    int32 index = 0;
    IParamValueQueue* queue = data.outputParameterChanges->addParameterData(kLevel, index);
    if (queue == nullptr)
        return;
    queue->addPoint(0, std::min(1.0, static_cast<double>(peak)), index);
    mReported = peak;
}

} // namespace effects::balance
