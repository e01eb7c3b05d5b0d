#include "tests/plugins/support/Recorder.h"
#include "tests/plugins/vst2/support/Instance.h"

#include <atomic>
#include <cstdio>
#include <cstring>

namespace vst2fixture
{

namespace
{

// What this host has for texts of parameters.
constexpr std::size_t kRoom = 128;

// Parameters beyond those there are: fixtures that lie about their number.
const Parameter& ParameterAt(std::int32_t index)
{
    static const Parameter sOther{"More", ""};
    const auto& parameters = TheBehaviour().parameters;
    const auto place = static_cast<std::size_t>(index);
    return index >= 0 && place < parameters.size() ? parameters[place] : sOther;
}

} // namespace

// Null for a parameter that there isn't.
float* Instance::ValueAt(std::int32_t index)
{
    const auto place = static_cast<std::size_t>(index);
    return index >= 0 && place < Current().size() ? &Current()[place] : nullptr;
}

void Instance::SetParameterProc(AEffect* effect, std::int32_t index, float value)
{
    fixture::Record("setParameter", index, value);
    ThrowIf(GetInt(Knob::kParameterThrows));
    if (float* place = Of(effect).ValueAt(index))
        std::atomic_ref<float>(*place).store(value, std::memory_order_relaxed);
}

float Instance::GetParameterProc(AEffect* effect, std::int32_t index)
{
    fixture::Record("getParameter", index);
    ThrowIf(GetInt(Knob::kParameterThrows));
    float* place = Of(effect).ValueAt(index);
    return place != nullptr ? std::atomic_ref<float>(*place).load(std::memory_order_relaxed) : 0.0F;
}

long long Instance::AnswerParameter(const Call& call)
{
    const Parameter& parameter = ParameterAt(call.index);
    switch (call.opcode)
    {
    case effGetParamName:
        GiveText(call.ptr, parameter.name, kRoom);
        return 1;
    case effGetParamLabel:
        GiveText(call.ptr, parameter.label, kRoom);
        return 1;
    case effGetParamDisplay:
    {
        const float* value = ValueAt(call.index);
        char text[16];
        std::snprintf(text, sizeof(text), "%d%%", static_cast<int>(100.0F * (value != nullptr ? *value : 0.0F)));
        GiveText(call.ptr, TheBehaviour().hasDisplay ? text : "", kRoom);
        return 1;
    }
    case effCanBeAutomated:
        return parameter.canBeAutomated ? 1 : 0;
    default:
        return Describe(call.index, *static_cast<VstParameterProperties*>(call.ptr));
    }
}

long long Instance::Describe(std::int32_t index, VstParameterProperties& properties) const
{
    const Parameter& parameter = ParameterAt(index);
    if (!parameter.properties)
        return 0;
    GiveText(properties.label, parameter.label, sizeof(properties.label));
    properties.flags = parameter.properties->flags;
    properties.minInteger = parameter.properties->minimum;
    properties.maxInteger = parameter.properties->maximum;
    properties.stepInteger = parameter.properties->step;
    return 1;
}

} // namespace vst2fixture
