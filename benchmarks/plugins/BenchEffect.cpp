#include "benchmarks/plugins/BenchEffect.h"

#include "examples/effects/support/StateStream.h"
#include "examples/effects/support/Text.h"

#include <algorithm>
#include <string>

namespace effects::bench
{

namespace
{

constexpr double kInitial = 0.25;

BenchEffect* sLatest = nullptr;

// In two steps, so that it costs the same whether the host processes in place or not. Turning the sign keeps the
// signal as loud as it came, however often a block runs through here.
void Invert(const float* in, float* out, int32 frames)
{
    if (in != out)
        std::copy_n(in, frames, out);
    for (int32 frame = 0; frame < frames; ++frame)
        out[frame] = -out[frame];
}

} // namespace

BenchEffect::BenchEffect(int parameters)
    : ProcessorPart(BusSet({{u"Input", SpeakerArr::kStereo}}, {{u"Output", SpeakerArr::kStereo}}))
    , mShown(static_cast<std::size_t>(parameters))
    , mProcessed(static_cast<std::size_t>(parameters), kInitial)
{
    for (auto& value : mShown)
        value = kInitial;
    sLatest = this;
}

BenchEffect::~BenchEffect()
{
    if (sLatest == this)
        sLatest = nullptr;
}

BenchSide* BenchEffect::Latest()
{
    return sLatest;
}

tresult PLUGIN_API BenchEffect::process(ProcessData& data)
{
    if (data.inputParameterChanges != nullptr)
        TakePoints(*data.inputParameterChanges);
    if (data.numInputs < 1 || data.numOutputs < 1)
        return kResultOk;
    const int32 channels = std::min(data.inputs[0].numChannels, data.outputs[0].numChannels);
    for (int32 channel = 0; channel < channels; ++channel)
        Invert(data.inputs[0].channelBuffers32[channel], data.outputs[0].channelBuffers32[channel], data.numSamples);
    return kResultOk;
}

void BenchEffect::TakePoints(IParameterChanges& changes)
{
    const int32 count = changes.getParameterCount();
    for (int32 index = 0; index < count; ++index)
    {
        IParamValueQueue* queue = changes.getParameterData(index);
        int32 offset = 0;
        double value = 0.0;
        for (int32 point = 0; queue->getPoint(point, offset, value) == kResultOk; ++point)
        {
            mProcessed.at(queue->getParameterId()) = value;
            ++mPoints;
        }
    }
}

tresult PLUGIN_API BenchEffect::setState(IBStream* state)
{
    StateReader reader(state);
    for (auto& shown : mShown)
    {
        double value = 0.0;
        reader.Read(value);
        if (reader.Failed())
            return kResultFalse;
        shown.store(value, std::memory_order_relaxed);
    }
    return kResultOk;
}

tresult PLUGIN_API BenchEffect::getState(IBStream* state)
{
    StateWriter writer(state);
    for (const auto& shown : mShown)
        writer.Write(shown.load(std::memory_order_relaxed));
    return writer.Failed() ? kResultFalse : kResultOk;
}

tresult PLUGIN_API BenchEffect::getParameterInfo(int32 index, ParameterInfo& info)
{
    if (index < 0 || index >= getParameterCount())
        return kInvalidArgument;
    info = {};
    info.id = static_cast<ParamID>(index);
    const std::u16string number = NumberText(index, 0);
    CopyText(u"Parameter " + number, info.title);
    CopyText(number, info.shortTitle);
    info.defaultNormalizedValue = kInitial;
    info.flags = ParameterInfo::kCanAutomate;
    return kResultOk;
}

tresult PLUGIN_API BenchEffect::getParamStringByValue(ParamID, ParamValue value, String128 text)
{
    CopyText(NumberText(value, 3), text);
    return kResultOk;
}

ParamValue PLUGIN_API BenchEffect::getParamNormalized(ParamID id)
{
    return id < mShown.size() ? mShown[id].load(std::memory_order_relaxed) : 0.0;
}

tresult PLUGIN_API BenchEffect::setParamNormalized(ParamID id, ParamValue value)
{
    if (id >= mShown.size())
        return kInvalidArgument;
    mShown[id].store(value, std::memory_order_relaxed);
    return kResultOk;
}

tresult PLUGIN_API BenchEffect::setComponentHandler(IComponentHandler* handler)
{
    mHandler = handler;
    return kResultOk;
}

// An editor has the controller's value set before it tells the host.
void BenchEffect::PerformEdits(int first, int count, double value)
{
    for (int index = first; index < first + count; ++index)
    {
        const auto id = static_cast<ParamID>(index);
        setParamNormalized(id, value);
        if (mHandler)
            mHandler->performEdit(id, value);
    }
}

} // namespace effects::bench
