#pragma once

#include "examples/effects/support/Vst3.h"

#include <atomic>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace effects
{

// How one parameter looks. The host sees values from 0 to 1; minimum and maximum are in the parameter's own unit.
struct Parameter
{
    ParamID id;
    const char16_t* title;
    const char16_t* units;
    double minimum;
    double maximum;
    double initial;
    int32 stepCount = 0; // 0 is continuous, 1 a switch
    int32 flags = ParameterInfo::kCanAutomate;
    int decimals = 1;
    std::vector<std::u16string> choices = {}; // texts of a list, one for each step
    const char16_t* minimumText = nullptr;    // stands for the smallest value, such as "-inf"

    double ToPlain(double normalized) const;
    double ToNormalized(double plain) const;
    std::u16string ToText(double normalized) const;
    std::optional<double> FromText(std::u16string_view text) const; // normalized
};

// The parameters of an effect and their values. Looks are fixed at construction; values are atomic, since the host's
// main thread, the audio thread and an editor all touch them.
class ParameterSet
{
public:
    ParameterSet(std::initializer_list<Parameter> parameters);
    explicit ParameterSet(std::vector<Parameter> parameters);

    int32 Count() const { return static_cast<int32>(mParameters.size()); }
    const Parameter* At(int32 index) const; // null beyond the end
    const Parameter* Find(ParamID id) const;
    tresult GetInfo(int32 index, ParameterInfo& info) const;

    bool Set(ParamID id, double normalized); // false if there is no such parameter
    double Get(ParamID id) const;            // normalized, 0 if there is no such parameter
    double Plain(ParamID id) const;

    tresult Save(IBStream* stream) const;
    tresult Load(IBStream* stream); // all or nothing: a damaged state changes no value

private:
    const Parameter* FindWithIndex(ParamID id, std::size_t& index) const;

    std::vector<Parameter> mParameters;
    std::unique_ptr<std::atomic<double>[]> mValues;
};

} // namespace effects
