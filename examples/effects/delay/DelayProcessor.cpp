#include "examples/effects/delay/DelayProcessor.h"

#include "examples/effects/support/ParameterPoints.h"

#include <algorithm>
#include <cmath>

namespace effects::delay
{

DelayProcessor::DelayProcessor()
    : Processor(BusSet({{u"Input", SpeakerArr::kStereo}}, {{u"Output", SpeakerArr::kStereo}}))
{
}

tresult PLUGIN_API DelayProcessor::getControllerClassId(TUID classID)
{
    kControllerID.toTUID(classID);
    return kResultOk;
}

tresult PLUGIN_API DelayProcessor::setActive(TBool state)
{
    if (state == 0)
        return kResultOk;
    mLookAhead = getLatencySamples();
    const auto longest = static_cast<std::size_t>(kMaxTime / 1000.0 * mSetup.sampleRate) + 1;
    for (Channel& channel : mChannels)
    {
        channel.input.Resize(mLookAhead);
        channel.repeats.Resize(longest);
    }
    return kResultOk;
}

uint32 PLUGIN_API DelayProcessor::getLatencySamples()
{
    return static_cast<uint32>(std::lround(mParameters.Plain(kLookAhead)));
}

// Until a repeat lies 60 dB below the first.
uint32 PLUGIN_API DelayProcessor::getTailSamples()
{
    const double feedback = mParameters.Plain(kFeedback) / 100.0;
    const double repeats = feedback > 0.001 ? 1.0 + std::ceil(std::log(0.001) / std::log(feedback)) : 1.0;
    return getLatencySamples() + static_cast<uint32>(repeats * static_cast<double>(TimeInSamples()));
}

tresult PLUGIN_API DelayProcessor::notify(IMessage* message)
{
    int64 samples = 0;
    if (!IsCalled(message, kLookAheadMessage) ||
        message->getAttributes()->getInt(kSamplesAttribute, samples) != kResultOk)
        return kResultFalse;
    mParameters.Set(kLookAhead, mParameters.Find(kLookAhead)->ToNormalized(static_cast<double>(samples)));
    return kResultOk;
}

std::size_t DelayProcessor::TimeInSamples() const
{
    return std::max<std::size_t>(1, static_cast<std::size_t>(mParameters.Plain(kTime) / 1000.0 * mSetup.sampleRate));
}

tresult PLUGIN_API DelayProcessor::process(ProcessData& data)
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

void DelayProcessor::Render(ProcessData& data, int32 first, int32 count)
{
    const std::size_t time = TimeInSamples();
    const auto feedback = static_cast<float>(mParameters.Plain(kFeedback) / 100.0);
    const auto mix = static_cast<float>(mParameters.Plain(kMix) / 100.0);
    const int32 channels = std::min({data.inputs[0].numChannels, data.outputs[0].numChannels, int32{2}});
    for (int32 number = 0; number < channels; ++number)
    {
        const float* in = data.inputs[0].channelBuffers32[number] + first;
        float* out = data.outputs[0].channelBuffers32[number] + first;
        Channel& channel = mChannels[static_cast<std::size_t>(number)];
        for (int32 i = 0; i < count; ++i)
        {
            channel.input.Push(in[i]);
            const float dry = channel.input.Ago(mLookAhead);
            const float repeat = channel.repeats.Ago(time - 1);
            channel.repeats.Push(dry + repeat * feedback);
            out[i] = dry + mix * (repeat - dry);
        }
    }
}

} // namespace effects::delay
