#include "examples/effects/support/ParameterSet.h"

#include "examples/effects/support/StateStream.h"
#include "examples/effects/support/Text.h"

#include <algorithm>
#include <cmath>

namespace effects
{

double Parameter::ToPlain(double normalized) const
{
    if (stepCount > 0)
        normalized = std::min<double>(stepCount, std::floor(normalized * (stepCount + 1))) / stepCount;
    return minimum + (maximum - minimum) * normalized;
}

double Parameter::ToNormalized(double plain) const
{
    return std::clamp((plain - minimum) / (maximum - minimum), 0.0, 1.0);
}

std::u16string Parameter::ToText(double normalized) const
{
    const double plain = ToPlain(normalized);
    if (minimumText != nullptr && plain <= minimum)
        return minimumText;
    if (!choices.empty())
        return choices[std::min(choices.size() - 1, static_cast<std::size_t>(std::lround(plain - minimum)))];
    return NumberText(plain, stepCount > 0 ? 0 : decimals);
}

std::optional<double> Parameter::FromText(std::u16string_view text) const
{
    if (minimumText != nullptr && text == minimumText)
        return 0.0;
    if (const auto choice = std::find(choices.begin(), choices.end(), text); choice != choices.end())
        return ToNormalized(minimum + static_cast<double>(choice - choices.begin()));
    if (const auto plain = ParseNumber(text))
        return ToNormalized(*plain);
    return std::nullopt;
}

ParameterSet::ParameterSet(std::initializer_list<Parameter> parameters)
    : ParameterSet(std::vector<Parameter>(parameters))
{
}

ParameterSet::ParameterSet(std::vector<Parameter> parameters)
    : mParameters(std::move(parameters)), mValues(std::make_unique<std::atomic<double>[]>(mParameters.size()))
{
    for (std::size_t i = 0; i < mParameters.size(); ++i)
        mValues[i] = mParameters[i].ToNormalized(mParameters[i].initial);
}

const Parameter* ParameterSet::At(int32 index) const
{
    return index >= 0 && index < Count() ? &mParameters[static_cast<std::size_t>(index)] : nullptr;
}

const Parameter* ParameterSet::FindWithIndex(ParamID id, std::size_t& index) const
{
    const auto found = std::find_if(mParameters.begin(), mParameters.end(), [id](auto& p) { return p.id == id; });
    index = static_cast<std::size_t>(found - mParameters.begin());
    return found != mParameters.end() ? &*found : nullptr;
}

const Parameter* ParameterSet::Find(ParamID id) const
{
    std::size_t index = 0;
    return FindWithIndex(id, index);
}

tresult ParameterSet::GetInfo(int32 index, ParameterInfo& info) const
{
    const Parameter* parameter = At(index);
    if (parameter == nullptr)
        return kInvalidArgument;
    info = {};
    info.id = parameter->id;
    CopyText(parameter->title, info.title);
    CopyText(parameter->title, info.shortTitle);
    CopyText(parameter->units, info.units);
    info.stepCount = parameter->stepCount;
    info.defaultNormalizedValue = parameter->ToNormalized(parameter->initial);
    info.unitId = kRootUnitId;
    info.flags = parameter->flags;
    return kResultOk;
}

bool ParameterSet::Set(ParamID id, double normalized)
{
    std::size_t index = 0;
    if (FindWithIndex(id, index) == nullptr || !std::isfinite(normalized))
        return false;
    mValues[index].store(std::clamp(normalized, 0.0, 1.0), std::memory_order_relaxed);
    return true;
}

double ParameterSet::Get(ParamID id) const
{
    std::size_t index = 0;
    return FindWithIndex(id, index) != nullptr ? mValues[index].load(std::memory_order_relaxed) : 0.0;
}

double ParameterSet::Plain(ParamID id) const
{
    std::size_t index = 0;
    const Parameter* parameter = FindWithIndex(id, index);
    return parameter != nullptr ? parameter->ToPlain(mValues[index].load(std::memory_order_relaxed)) : 0.0;
}

tresult ParameterSet::Save(IBStream* stream) const
{
    StateWriter writer(stream);
    writer.Write(static_cast<uint32>(mParameters.size()));
    for (const Parameter& parameter : mParameters)
    {
        writer.Write(parameter.id);
        writer.Write(Get(parameter.id));
    }
    return writer.Failed() ? kResultFalse : kResultOk;
}

tresult ParameterSet::Load(IBStream* stream)
{
    StateReader reader(stream);
    uint32 count = 0;
    reader.Read(count);
    std::vector<std::pair<ParamID, double>> values;
    for (uint32 i = 0; i < count && !reader.Failed(); ++i)
    {
        std::pair<ParamID, double> value{};
        reader.Read(value.first);
        reader.Read(value.second);
        values.push_back(value);
    }
    if (reader.Failed())
        return kResultFalse;
    for (const auto& [id, value] : values)
        Set(id, value); // a parameter of another version of this effect is passed over
    return kResultOk;
}

} // namespace effects
