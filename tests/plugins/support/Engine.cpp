#include "tests/plugins/support/Engine.h"

#include "examples/effects/support/ParameterPoints.h"
#include "tests/plugins/support/Behaviour.h"
#include "tests/plugins/support/HostAccess.h"
#include "tests/plugins/support/Recorder.h"

#include <algorithm>
#include <stdexcept>

namespace fixture
{

namespace
{

// "2,2" for two buses of two channels; "-" for none.
template <class Value>
std::string BusList(const AudioBusBuffers* buses, int32 count, Value value)
{
    std::string text;
    for (int32 i = 0; i < count; ++i)
    {
        text += i > 0 ? "," : "";
        AddWord(text, value(buses[i]));
    }
    return text.empty() ? "-" : text;
}

void RecordBlock(const ProcessData& data)
{
    if (!IsRecording())
        return;
    const auto channels = [](const AudioBusBuffers& bus)
    {
        return bus.numChannels;
    };
    std::string points;
    VisitPoints(data,
                [&](ParamID id, int32 offset, ParamValue value)
                {
                    points += points.empty() ? "" : ",";
                    AddWord(points, id);
                    points += '@';
                    AddWord(points, offset);
                    points += ':';
                    AddWord(points, value);
                });
    Record("processor.process", data.numSamples, "in=" + BusList(data.inputs, data.numInputs, channels),
           "out=" + BusList(data.outputs, data.numOutputs, channels),
           "silence=" + BusList(data.inputs, data.numInputs, [](auto& bus) { return bus.silenceFlags; }),
           "points=" + (points.empty() ? "-" : points));
}

// For tests in which nothing may be recorded.
void CountPoints(const ProcessData& data)
{
    VisitPoints(data,
                [](ParamID id, int32, ParamValue)
                {
                    Set(Knob::kPointSeenLast, id);
                    Set(Knob::kPointsSeen, Get(Knob::kPointsSeen) + 1);
                });
}

void RecordContext(const ProcessData& data)
{
    if (!IsOn(Knob::kRecordContext))
        return;
    if (const ProcessContext* context = data.processContext)
        Record("processor.context", context->state, context->sampleRate, context->projectTimeSamples,
               context->projectTimeMusic, context->barPositionMusic, context->tempo, context->timeSigNumerator,
               context->timeSigDenominator);
    else
        Record("processor.context none");
}

void CallHost()
{
    IComponentHandler* handler = Handler();
    if (handler == nullptr)
        return;
    if (IsOn(Knob::kRestartInProcess))
        Record("processor.restartComponent", handler->restartComponent(GetInt(Knob::kRestartInProcess)));
    for (int i = 0; i < GetInt(Knob::kEditsInProcess); ++i)
        handler->performEdit(kAmount, i / 100.0);
}

void WriteOutputs(ProcessData& data)
{
    for (int32 bus = 0; bus < data.numOutputs; ++bus)
    {
        AudioBusBuffers& out = data.outputs[bus];
        out.silenceFlags =
            bus < 2 ? static_cast<uint64>(Get(bus == 0 ? Knob::kOutputSilence0 : Knob::kOutputSilence1)) : 0;
        for (int32 channel = 0; channel < out.numChannels; ++channel)
        {
            float* target = out.channelBuffers32[channel];
            const bool fed = bus < data.numInputs && channel < data.inputs[bus].numChannels;
            const float* source = fed ? data.inputs[bus].channelBuffers32[channel] : nullptr;
            const auto gain = static_cast<float>(Get(Knob::kGain));
            for (int32 i = 0; i < data.numSamples; ++i)
                target[i] = source != nullptr ? source[i] * gain : 0.0F;
        }
    }
    if (Get(Knob::kOutputValue) == kReal || data.outputParameterChanges == nullptr)
        return;
    int32 index = 0;
    if (IParamValueQueue* queue = data.outputParameterChanges->addParameterData(kMeter, index))
        queue->addPoint(0, Get(Knob::kOutputValue), index);
}

// Whoever plays an event bus gets one event back, which a host may do with as it likes.
void WriteEvents(ProcessData& data)
{
    Event event{};
    event.type = Event::kNoteOnEvent;
    if (data.outputEvents != nullptr)
        Record("processor.addEvent", data.outputEvents->addEvent(event));
}

} // namespace

tresult Engine::Process(ProcessData& data)
{
    RecordBlock(data);
    CountPoints(data);
    RecordContext(data);
    CallHost();
    if (GetInt(Knob::kProcessThrows) == 1)
        throw std::runtime_error("process throws");
    if (GetInt(Knob::kProcessThrows) == 2)
        throw 2;
    if (data.numSamples > 0)
        WriteOutputs(data);
    WriteEvents(data);
    return GetInt(Knob::kProcessResult);
}

void Engine::SetProcessing(bool on)
{
    if (on)
        mThread.Start();
    else
        mThread.Stop();
}

} // namespace fixture
