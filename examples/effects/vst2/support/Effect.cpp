#include "examples/effects/vst2/support/Effect.h"

#include "examples/effects/vst2/support/Text.h"

#include <utility>

namespace effects::vst2
{

Effect::Effect(audioMasterCallback host, Description description)
    : mHost(host), mDescription(std::move(description)), mValues(mDescription.parameters.size())
{
    for (std::size_t i = 0; i < mValues.size(); ++i)
        mValues[i] = mDescription.parameters[i].initial;
    mEffect.magic = kEffectMagic;
    mEffect.dispatcher = Dispatch;
    mEffect.process = nullptr; // effFlagsCanReplacing: nobody calls it
    mEffect.processReplacing = ProcessReplacing;
    mEffect.setParameter = SetParameterProc;
    mEffect.getParameter = GetParameterProc;
    mEffect.numPrograms = 1;
    mEffect.numParams = static_cast<std::int32_t>(mValues.size());
    mEffect.flags = effFlagsCanReplacing | mDescription.flags;
    mEffect.ioRatio = 1.0F;
    mEffect.object = this;
    mEffect.uniqueID = mDescription.uniqueID;
    mEffect.version = 1000;
    SetChannels(2, 2);
}

void Effect::SetChannels(std::int32_t inputs, std::int32_t outputs)
{
    mEffect.numInputs = inputs;
    mEffect.numOutputs = outputs;
}

long long Effect::AskHost(std::int32_t opcode, std::int32_t index, long long value, void* ptr, float opt)
{
    return mHost(&mEffect, opcode, index, value, ptr, opt);
}

float Effect::Get(std::int32_t index) const
{
    return mValues[static_cast<std::size_t>(index)].load(std::memory_order_relaxed);
}

void Effect::SetParameter(std::int32_t index, float value)
{
    mValues[static_cast<std::size_t>(index)].store(value, std::memory_order_relaxed);
}

std::string Effect::Display(std::int32_t index) const
{
    return Decimal(100.0F * Get(index), 1);
}

std::optional<float> Effect::Read(std::int32_t, const std::string& text) const
{
    const auto percent = Number(text);
    return percent ? std::optional(*percent / 100.0F) : std::nullopt;
}

long long Effect::Answer(const Call&)
{
    return 0;
}

long long Effect::Dispatch(AEffect* effect, std::int32_t opcode, std::int32_t index, long long value, void* ptr,
                           float opt)
{
    Effect& self = Of(effect);
    const Call call{opcode, index, value, ptr, opt};
    switch (opcode)
    {
    case effClose:
        // The host has owned it since the entry call.
        std::default_delete<Effect>()(&self);
        return 1;
    case effGetEffectName:
    case effGetVendorString:
    case effGetProductString:
        return self.AnswerText(call);
    case effGetParamName:
    case effGetParamLabel:
    case effGetParamDisplay:
    case effString2Parameter:
    case effCanBeAutomated:
    case effGetParameterProperties:
        return self.IsParameter(index) ? self.AnswerParameter(call) : 0;
    default:
        return self.AnswerUsual(call);
    }
}

long long Effect::AnswerText(const Call& call) const
{
    if (call.opcode == effGetEffectName)
        CopyText(call.ptr, mDescription.name, kNameLength);
    else
        CopyText(call.ptr, call.opcode == effGetVendorString ? "Zeb Audio" : "Zeb Effects", kVendorLength);
    return 1;
}

long long Effect::AnswerParameter(const Call& call)
{
    const Parameter& parameter = mDescription.parameters[static_cast<std::size_t>(call.index)];
    switch (call.opcode)
    {
    case effGetParamName:
        CopyText(call.ptr, parameter.name, kParameterLength);
        return 1;
    case effGetParamLabel:
        CopyText(call.ptr, parameter.label, kParameterLength);
        return 1;
    case effGetParamDisplay:
        CopyText(call.ptr, Display(call.index), kParameterLength);
        return 1;
    case effString2Parameter:
        // Without a text the host asks whether there is a way at all.
        if (call.ptr == nullptr)
            return 1;
        if (const auto value = Read(call.index, static_cast<const char*>(call.ptr)))
        {
            SetParameter(call.index, *value);
            return 1;
        }
        return 0;
    case effGetParameterProperties:
        return Describe(call.index, *static_cast<VstParameterProperties*>(call.ptr));
    default:
        return 1; // each can be automated
    }
}

long long Effect::Describe(std::int32_t index, VstParameterProperties& properties) const
{
    const Parameter& parameter = mDescription.parameters[static_cast<std::size_t>(index)];
    CopyText(properties.label, parameter.label, sizeof(properties.label));
    CopyText(properties.shortLabel, parameter.label, sizeof(properties.shortLabel));
    properties.flags = parameter.flags;
    return 1;
}

long long Effect::AnswerUsual(const Call& call)
{
    switch (call.opcode)
    {
    case effSetSampleRate:
        mSampleRate = call.opt;
        return 0;
    case effMainsChanged:
        if (call.value != 0)
            Start();
        return 0;
    case effGetPlugCategory:
        return mDescription.category;
    case effGetVendorVersion:
        return mEffect.version;
    case effGetVstVersion:
        return 2400;
    default:
        return Answer(call);
    }
}

void Effect::ProcessReplacing(AEffect* effect, float** inputs, float** outputs, std::int32_t frames)
{
    Of(effect).Process(inputs, outputs, frames);
}

void Effect::SetParameterProc(AEffect* effect, std::int32_t index, float value)
{
    if (Of(effect).IsParameter(index))
        Of(effect).SetParameter(index, value);
}

float Effect::GetParameterProc(AEffect* effect, std::int32_t index)
{
    return Of(effect).IsParameter(index) ? Of(effect).Get(index) : 0.0F;
}

} // namespace effects::vst2
