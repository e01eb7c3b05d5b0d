#include "tests/plugins/vst2/support/Instance.h"

#include "tests/plugins/support/Recorder.h"

#include <algorithm>
#include <cstring>
#include <list>
#include <mutex>
#include <stdexcept>

namespace vst2fixture
{

namespace
{

std::mutex sMutex;
std::list<Instance*> sInstances; // newest last

} // namespace

Instance::Instance(audioMasterCallback host, std::int32_t uniqueID, const Member* member)
    : mHost(host), mMember(member)
{
    const Behaviour& behaviour = TheBehaviour();
    Values values;
    for (const Parameter& parameter : behaviour.parameters)
        values.push_back(parameter.initial);
    mPrograms.assign(std::max<std::size_t>(behaviour.programs.size(), 1), values);
    for (std::size_t i = 0; i < mPrograms.size() && !values.empty(); ++i)
        mPrograms[i].front() = std::min(static_cast<float>(i) * 0.25F, 1.0F);

    mEffect.magic = GetInt(Knob::kMagic);
    mEffect.dispatcher = Dispatch;
    mEffect.process = ProcessProc;
    mEffect.processReplacing = ProcessReplacingProc;
    mEffect.setParameter = SetParameterProc;
    mEffect.getParameter = GetParameterProc;
    mEffect.ioRatio = 1.0F;
    mEffect.object = this;
    mEffect.uniqueID = uniqueID;
    mEffect.version = 1;
    mEffect.numInputs = GetInt(Knob::kInputs);
    mEffect.numOutputs = GetInt(Knob::kOutputs);
    Refresh();
    const std::lock_guard lock(sMutex);
    sInstances.push_back(this);
    fixture::CountLiveObject(1);
}

Instance::~Instance()
{
    const std::lock_guard lock(sMutex);
    sInstances.remove(this);
    fixture::CountLiveObject(-1);
}

Instance* Instance::Newest()
{
    const std::lock_guard lock(sMutex);
    return sInstances.empty() ? nullptr : sInstances.back();
}

void Instance::RefreshAll()
{
    const std::lock_guard lock(sMutex);
    for (Instance* instance : sInstances)
        instance->Refresh();
}

void Instance::Refresh()
{
    const Behaviour& behaviour = TheBehaviour();
    mEffect.numParams = GetInt(Knob::kParameterCount, static_cast<int>(behaviour.parameters.size()));
    mEffect.numPrograms = GetInt(Knob::kProgramCount, static_cast<int>(behaviour.programs.size()));
    mEffect.initialDelay = GetInt(Knob::kLatency);
    const auto flag = [](Knob knob, std::int32_t bit)
    {
        return IsOn(knob) ? bit : 0;
    };
    const bool isSynth = mMember != nullptr ? mMember->isSynth : IsOn(Knob::kIsSynth);
    mEffect.flags = flag(Knob::kCanMono, effFlagsCanMono) | flag(Knob::kCanReplacing, effFlagsCanReplacing) |
                    flag(Knob::kChunks, effFlagsProgramChunks) | flag(Knob::kEditor, effFlagsHasEditor) |
                    (isSynth ? effFlagsIsSynth : 0);
}

long long Instance::Dispatch(AEffect* effect, std::int32_t opcode, std::int32_t index, long long value, void* ptr,
                             float opt)
{
    const Call call{opcode, index, value, ptr, opt};
    if (fixture::IsRecording())
        fixture::Append(CallLine(call));
    Instance& self = Of(effect);
    const double throws = Get(Knob::kDispatcherThrows);
    const bool isAskedUnguarded =
        opcode == effGetVstVersion || opcode == effGetPlugCategory || opcode == effShellGetNextPlugin;
    const bool isThrown = throws == kReal ? !isAskedUnguarded && opcode != effClose : throws == opcode;
    if (opcode == effClose)
    {
        if (IsOn(Knob::kCallsInClose))
            CallHostForEverything({self.mHost, IsOn(Knob::kCallsWithoutEffect) ? nullptr : effect}, "close");
        delete &self;
    }
    if (isThrown)
        throw std::runtime_error("thrown by the dispatcher");
    return opcode == effClose ? 1 : self.Answer(call);
}

long long Instance::Answer(const Call& call)
{
    switch (call.opcode)
    {
    case effGetParamLabel:
    case effGetParamDisplay:
    case effGetParamName:
    case effCanBeAutomated:
    case effGetParameterProperties:
        return AnswerParameter(call);
    case effSetProgram:
    case effGetProgram:
    case effGetChunk:
    case effSetChunk:
        return AnswerState(call);
    case effSetSpeakerArrangement:
    case effGetSpeakerArrangement:
        return AnswerArrangement(call);
    case effEditGetRect:
    case effEditOpen:
    case effEditClose:
        return AnswerEditor(call);
    case effGetPlugCategory:
    case effShellGetNextPlugin:
        return AnswerShell(call);
    case effGetProgramName:
    case effGetProgramNameIndexed:
    case effGetEffectName:
    case effGetVendorString:
    case effGetProductString:
        return AnswerText(call);
    default:
        return AnswerLife(call);
    }
}

long long Instance::AnswerLife(const Call& call)
{
    switch (call.opcode)
    {
    case effOpen:
        Open();
        return 0;
    case effMainsChanged:
        Switch(call.value != 0);
        return 0;
    case effGetVstVersion:
        return GetInt(Knob::kVersion);
    case effGetTailSize:
        return GetInt(Knob::kTail);
    case effVendorSpecific:
        return GetInt(Knob::kVendorAnswer);
    default:
        return 0;
    }
}

void Instance::Open()
{
    Happen(TheBehaviour().atOpen);
    if (IsOn(Knob::kCallsInOpen))
        CallHostForEverything({mHost, IsOn(Knob::kCallsWithoutEffect) ? nullptr : &mEffect}, "open");
}

void Instance::Switch(bool on)
{
    mThread.Stop();
    if (on && IsOn(Knob::kThreadCalls))
        mThread.Start(Host());
}

void Instance::Process(float** inputs, float** outputs, std::int32_t frames, bool adds)
{
    const std::int32_t ins = std::max(mEffect.numInputs, 0);
    const std::int32_t outs = std::max(mEffect.numOutputs, 0);
    const auto missing = std::count(inputs, inputs + ins, nullptr) + std::count(outputs, outputs + outs, nullptr);
    fixture::Record(adds ? "process" : "processReplacing", frames, ins, outs, "null=", missing);
    Happen(TheBehaviour().atProcess);
    ThrowIf(GetInt(Knob::kProcessThrows));
    if (IsOn(Knob::kTimeInProcess))
    {
        if (fixture::IsRecording())
            fixture::Record("process.audioMasterGetTime ->", CallHost(Host(), "audioMasterGetTime"));
        else
            mHost(&mEffect, audioMasterGetTime, 0, 0, nullptr, 0.0F);
    }
    const auto gain = static_cast<float>(Get(Knob::kGain));
    for (std::int32_t out = 0; out < outs; ++out)
    {
        const float* in = ins > 0 ? inputs[out % ins] : nullptr;
        for (std::int32_t i = 0; outputs[out] != nullptr && i < frames; ++i)
            outputs[out][i] = (adds ? outputs[out][i] : 0.0F) + (in != nullptr ? gain * in[i] : 0.0F);
    }
}

void Instance::ProcessProc(AEffect* effect, float** inputs, float** outputs, std::int32_t frames)
{
    Of(effect).Process(inputs, outputs, frames, true);
}

void Instance::ProcessReplacingProc(AEffect* effect, float** inputs, float** outputs, std::int32_t frames)
{
    Of(effect).Process(inputs, outputs, frames, false);
}

void ThrowIf(int kind)
{
    if (kind == 1)
        throw std::runtime_error("thrown by a fixture");
    if (kind == 2)
        throw 2;
}

void GiveText(void* target, const std::string& text, std::size_t room)
{
    const bool isFull = IsOn(Knob::kFullTexts);
    if (isFull)
        std::memset(target, '+', room);
    std::memcpy(target, text.c_str(), std::min(isFull ? text.size() : text.size() + 1, room));
}

} // namespace vst2fixture
