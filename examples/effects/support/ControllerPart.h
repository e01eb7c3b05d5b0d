#pragma once

#include "examples/effects/support/Implements.h"
#include "examples/effects/support/ParameterSet.h"
#include "examples/effects/support/Text.h"

namespace effects
{

// The half of an effect that the user sees, IEditController, on a set of parameters. Base is an Implements<...> with
// this interface among others, or a ProcessorPart of one if component and controller are one object.
template <class Base>
class ControllerPart : public Base
{
public:
    template <class... Arguments>
    explicit ControllerPart(ParameterSet parameters, Arguments&&... arguments)
        : Base(std::forward<Arguments>(arguments)...), mParameters(std::move(parameters))
    {
    }

    int32 PLUGIN_API getParameterCount() override { return mParameters.Count(); }

    tresult PLUGIN_API getParameterInfo(int32 index, ParameterInfo& info) override
    {
        return mParameters.GetInfo(index, info);
    }

    tresult PLUGIN_API getParamStringByValue(ParamID id, ParamValue normalized, String128 text) override
    {
        const Parameter* parameter = mParameters.Find(id);
        if (parameter == nullptr)
            return kInvalidArgument;
        CopyText(parameter->ToText(normalized), text);
        return kResultOk;
    }

    // NOLINTNEXTLINE(readability-non-const-parameter): the linter sees no override in a class template
    tresult PLUGIN_API getParamValueByString(ParamID id, TChar* text, ParamValue& normalized) override
    {
        const Parameter* parameter = mParameters.Find(id);
        const auto value = parameter != nullptr ? parameter->FromText(text) : std::nullopt;
        if (!value)
            return kResultFalse;
        normalized = *value;
        return kResultOk;
    }

    ParamValue PLUGIN_API normalizedParamToPlain(ParamID id, ParamValue normalized) override
    {
        const Parameter* parameter = mParameters.Find(id);
        return parameter != nullptr ? parameter->ToPlain(normalized) : normalized;
    }

    ParamValue PLUGIN_API plainParamToNormalized(ParamID id, ParamValue plain) override
    {
        const Parameter* parameter = mParameters.Find(id);
        return parameter != nullptr ? parameter->ToNormalized(plain) : plain;
    }

    ParamValue PLUGIN_API getParamNormalized(ParamID id) override { return mParameters.Get(id); }

    tresult PLUGIN_API setParamNormalized(ParamID id, ParamValue value) override
    {
        return mParameters.Set(id, value) ? kResultOk : kInvalidArgument;
    }

    // The component's state is its parameters, so a controller of its own learns the values here.
    tresult PLUGIN_API setComponentState(IBStream* state) override { return mParameters.Load(state); }

    tresult PLUGIN_API setComponentHandler(IComponentHandler* handler) override
    {
        mHandler = handler;
        return kResultOk;
    }

    IPlugView* PLUGIN_API createView(FIDString) override { return nullptr; }

protected:
    ParameterSet mParameters;
    IPtr<IComponentHandler> mHandler; // null until the host sets it
};

} // namespace effects
