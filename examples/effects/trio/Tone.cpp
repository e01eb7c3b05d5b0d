#include "examples/effects/trio/Tone.h"

#include "examples/effects/support/ParameterPoints.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace effects::trio
{

namespace
{

constexpr ParamID kLevel = 0; // dB

ParameterSet MakeParameters()
{
    return {{.id = kLevel, .title = u"Level", .units = u"dB", .minimum = -60.0, .maximum = 0.0, .initial = -12.0}};
}

double Frequency(int16 pitch)
{
    return 440.0 * std::exp2((pitch - 69) / 12.0);
}

} // namespace

Tone::Tone()
    : SingleComponent(MakeParameters(), BusSet({{u"Notes", 0, kMain, kEvent}}, {{u"Output", SpeakerArr::kStereo}}))
{
}

tresult PLUGIN_API Tone::setActive(TBool)
{
    mVoices = {};
    return kResultOk;
}

tresult PLUGIN_API Tone::process(ProcessData& data)
{
    TakeEvents(data.inputEvents);
    bool silent = true;
    ProcessInStretches(
        data, [this](ParamID id, ParamValue value) { mParameters.Set(id, value); },
        [&](int32 first, int32 count)
        {
            const auto level = static_cast<float>(std::pow(10.0, mParameters.Plain(kLevel) / 20.0));
            for (int32 i = first; i < first + count && data.numOutputs > 0; ++i)
            {
                const float sample = NextSample() * level;
                silent = silent && sample == 0.0F;
                for (int32 channel = 0; channel < data.outputs[0].numChannels; ++channel)
                    data.outputs[0].channelBuffers32[channel][i] = sample;
            }
        });
    if (data.numOutputs > 0)
        data.outputs[0].silenceFlags = silent ? 3 : 0;
    return kResultOk;
}

void Tone::TakeEvents(IEventList* events)
{
    for (int32 i = 0; events != nullptr && i < events->getEventCount(); ++i)
    {
        Event event{};
        if (events->getEvent(i, event) != kResultOk)
            continue;
        if (event.type == Event::kNoteOnEvent)
            Start(event.noteOn.pitch, event.noteOn.velocity);
        else if (event.type == Event::kNoteOffEvent)
            Stop(event.noteOff.pitch);
    }
}

void Tone::Start(int16 pitch, float velocity)
{
    const auto unused = std::find_if(mVoices.begin(), mVoices.end(), [](auto& voice) { return voice.pitch < 0; });
    if (unused != mVoices.end())
        *unused = {pitch, 0.0, velocity};
}

void Tone::Stop(int16 pitch)
{
    for (Voice& voice : mVoices)
        if (voice.pitch == pitch)
            voice.pitch = -1;
}

float Tone::NextSample()
{
    double sum = 0.0;
    for (Voice& voice : mVoices)
    {
        if (voice.pitch < 0)
            continue;
        sum += std::sin(2.0 * std::numbers::pi * voice.phase) * static_cast<double>(voice.velocity);
        voice.phase = std::fmod(voice.phase + Frequency(voice.pitch) / mSetup.sampleRate, 1.0);
    }
    return static_cast<float>(sum);
}

} // namespace effects::trio
