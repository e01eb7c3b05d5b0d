#include "examples/effects/trio/Tremolo.h"

#include "examples/effects/support/ParameterPoints.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

namespace effects::trio
{

namespace
{

constexpr ParamID kRate = 0;    // Hz
constexpr ParamID kDepth = 1;   // %
constexpr ParamID kProgram = 2; // index into kPrograms

struct Program
{
    const char16_t* name;
    double rate;
    double depth;
};

constexpr std::array<Program, 5> kPrograms{{
    {u"Still", 1.0, 0.0},
    {u"Slow Swell", 0.5, 60.0},
    {u"Amplifier", 5.0, 50.0},
    {u"Flutter", 11.0, 35.0},
    {u"Chopper", 8.0, 100.0},
}};

std::vector<std::u16string> ProgramNames()
{
    std::vector<std::u16string> names;
    for (const Program& program : kPrograms)
        names.emplace_back(program.name);
    return names;
}

ParameterSet MakeParameters()
{
    return {
        {.id = kRate, .title = u"Rate", .units = u"Hz", .minimum = 0.1, .maximum = 20.0, .initial = 5.0},
        {.id = kDepth, .title = u"Depth", .units = u"%", .minimum = 0.0, .maximum = 100.0, .initial = 50.0},
        {.id = kProgram,
         .title = u"Program",
         .units = u"",
         .minimum = 0.0,
         .maximum = kPrograms.size() - 1.0,
         .initial = 2.0,
         .stepCount = static_cast<int32>(kPrograms.size()) - 1,
         .flags = ParameterInfo::kIsProgramChange | ParameterInfo::kIsList,
         .choices = ProgramNames()},
    };
}

} // namespace

Tremolo::Tremolo()
    : ProgramList(ProgramNames(), MakeParameters(),
                  BusSet({{u"Input", SpeakerArr::kStereo}}, {{u"Output", SpeakerArr::kStereo}}))
{
}

// A program change arrives twice, here and with the next block, and both times does the same.
tresult PLUGIN_API Tremolo::setParamNormalized(ParamID id, ParamValue value)
{
    if (mParameters.Find(id) == nullptr)
        return kInvalidArgument;
    Apply(id, value);
    if (id == kProgram && mHandler != nullptr)
        mHandler->restartComponent(kParamValuesChanged);
    return kResultOk;
}

void Tremolo::Apply(ParamID id, ParamValue value)
{
    mParameters.Set(id, value);
    if (id != kProgram)
        return;
    const Program& program = kPrograms[static_cast<std::size_t>(mParameters.Plain(kProgram))];
    mParameters.Set(kRate, mParameters.Find(kRate)->ToNormalized(program.rate));
    mParameters.Set(kDepth, mParameters.Find(kDepth)->ToNormalized(program.depth));
}

tresult PLUGIN_API Tremolo::setActive(TBool)
{
    mPhase = 0.0;
    return kResultOk;
}

tresult PLUGIN_API Tremolo::process(ProcessData& data)
{
    ProcessInStretches(
        data, [this](ParamID id, ParamValue value) { Apply(id, value); },
        [&](int32 first, int32 count)
        {
            if (data.numInputs > 0 && data.numOutputs > 0)
                Render(data, first, count);
        });
    return kResultOk;
}

void Tremolo::Render(ProcessData& data, int32 first, int32 count)
{
    const double step = mParameters.Plain(kRate) / mSetup.sampleRate;
    const double depth = mParameters.Plain(kDepth) / 100.0;
    const int32 channels = std::min(data.inputs[0].numChannels, data.outputs[0].numChannels);
    for (int32 i = first; i < first + count; ++i)
    {
        const double fade = 0.5 - 0.5 * std::cos(2.0 * std::numbers::pi * mPhase);
        const auto gain = static_cast<float>(1.0 - depth * fade);
        for (int32 channel = 0; channel < channels; ++channel)
            data.outputs[0].channelBuffers32[channel][i] = data.inputs[0].channelBuffers32[channel][i] * gain;
        mPhase = std::fmod(mPhase + step, 1.0);
    }
}

} // namespace effects::trio
