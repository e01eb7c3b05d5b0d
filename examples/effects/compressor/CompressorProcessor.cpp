#include "examples/effects/compressor/CompressorProcessor.h"

#include "examples/effects/support/ParameterPoints.h"

#include <algorithm>
#include <cmath>

namespace effects::compressor
{

namespace
{

constexpr int32 kMainBus = 0;
constexpr int32 kSideChainBus = 1;

// How far a follower moves in one sample to cover 63 % of the way in the given time.
float PerSample(double milliseconds, double sampleRate)
{
    return static_cast<float>(1.0 - std::exp(-1000.0 / (milliseconds * sampleRate)));
}

float Peak(const AudioBusBuffers& bus, int32 sample)
{
    float peak = 0.0F;
    for (int32 channel = 0; channel < bus.numChannels; ++channel)
        peak = std::max(peak, std::abs(bus.channelBuffers32[channel][sample]));
    return peak;
}

} // namespace

CompressorProcessor::CompressorProcessor()
    : Processor(BusSet({{u"Input", SpeakerArr::kStereo}, {u"Side-chain", SpeakerArr::kStereo, kAux}},
                       {{u"Output", SpeakerArr::kStereo}}))
{
}

tresult PLUGIN_API CompressorProcessor::getControllerClassId(TUID classID)
{
    kControllerID.toTUID(classID);
    return kResultOk;
}

// The side-chain may differ from the main buses, and a host may leave it out.
tresult PLUGIN_API CompressorProcessor::setBusArrangements(SpeakerArrangement* inputs, int32 inputCount,
                                                           SpeakerArrangement* outputs, int32 outputCount)
{
    if (inputCount > kSideChainBus && !Supports(inputs[kSideChainBus]))
        return kResultFalse;
    const tresult result = Processor::setBusArrangements(inputs, inputCount, outputs, outputCount);
    if (result == kResultOk && inputCount > kSideChainBus)
        mBuses.SetArrangement(kInput, kSideChainBus, inputs[kSideChainBus]);
    return result;
}

tresult PLUGIN_API CompressorProcessor::setActive(TBool)
{
    mEnvelope = 0.0F;
    mReduction = 0.0;
    return kResultOk;
}

tresult PLUGIN_API CompressorProcessor::process(ProcessData& data)
{
    mReduction = 0.0;
    ProcessInStretches(
        data, [this](ParamID id, ParamValue value) { mParameters.Set(id, value); },
        [&](int32 first, int32 count)
        {
            if (data.numInputs > 0 && data.numOutputs > 0)
                Render(data, first, count);
        });
    ReportReduction(data);
    return kResultOk;
}

float CompressorProcessor::Follow(float level)
{
    mEnvelope += (level - mEnvelope) * (level > mEnvelope ? mAttackPerSample : mReleasePerSample);
    return mEnvelope;
}

void CompressorProcessor::Render(ProcessData& data, int32 first, int32 count)
{
    const double threshold = mParameters.Plain(kThreshold);
    const double slope = 1.0 - 1.0 / mParameters.Plain(kRatio);
    const double makeUp = mParameters.Plain(kMakeUp);
    mAttackPerSample = PerSample(mParameters.Plain(kAttack), mSetup.sampleRate);
    mReleasePerSample = PerSample(mParameters.Plain(kRelease), mSetup.sampleRate);

    const Bus* sideChain = mBuses.Find(kAudio, kInput, kSideChainBus);
    const bool external = sideChain->active && data.numInputs > kSideChainBus;
    const AudioBusBuffers& detected = data.inputs[external ? kSideChainBus : kMainBus];
    const AudioBusBuffers& in = data.inputs[kMainBus];
    AudioBusBuffers& out = data.outputs[0];
    for (int32 i = first; i < first + count; ++i)
    {
        const double level = 20.0 * std::log10(std::max(Follow(Peak(detected, i)), 1e-6F));
        const double reduction = std::max(0.0, level - threshold) * slope;
        mReduction = std::max(mReduction, reduction);
        const auto gain = static_cast<float>(std::pow(10.0, (makeUp - reduction) / 20.0));
        for (int32 channel = 0; channel < std::min(in.numChannels, out.numChannels); ++channel)
            out.channelBuffers32[channel][i] = in.channelBuffers32[channel][i] * gain;
    }
}

void CompressorProcessor::ReportReduction(ProcessData& data)
{
    if (data.outputParameterChanges == nullptr || mReduction == mReported)
        return;
    int32 index = 0;
    IParamValueQueue* queue = data.outputParameterChanges->addParameterData(kReduction, index);
    if (queue == nullptr)
        return;
    queue->addPoint(0, mParameters.Find(kReduction)->ToNormalized(mReduction), index);
    mReported = mReduction;
}

} // namespace effects::compressor
