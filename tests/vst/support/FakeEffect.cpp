#include "tests/vst/support/FakeEffect.h"

#include <algorithm>
#include <cstring>
#include <stdexcept>
#include <utility>

namespace fakeeffect
{

namespace
{

FakeEffect& SelfOf(AEffect* self)
{
    return *static_cast<FakeEffect*>(self->object);
}

const std::map<int, const char*>& OpcodeNames()
{
#define OPCODE(name)                                                                                                 \
    {                                                                                                                \
        name, #name                                                                                                  \
    }
    static const std::map<int, const char*> sNames = {
        OPCODE(effOpen),
        OPCODE(effClose),
        OPCODE(effSetProgram),
        OPCODE(effGetProgram),
        OPCODE(effSetProgramName),
        OPCODE(effGetProgramName),
        OPCODE(effGetParamLabel),
        OPCODE(effGetParamDisplay),
        OPCODE(effGetParamName),
        OPCODE(effSetSampleRate),
        OPCODE(effSetBlockSize),
        OPCODE(effMainsChanged),
        OPCODE(effEditGetRect),
        OPCODE(effEditOpen),
        OPCODE(effEditClose),
        OPCODE(effEditIdle),
        OPCODE(effGetChunk),
        OPCODE(effSetChunk),
        OPCODE(effProcessEvents),
        OPCODE(effCanBeAutomated),
        OPCODE(effGetProgramNameIndexed),
        OPCODE(effConnectInput),
        OPCODE(effConnectOutput),
        OPCODE(effGetInputProperties),
        OPCODE(effGetOutputProperties),
        OPCODE(effGetPlugCategory),
        OPCODE(effSetSpeakerArrangement),
        OPCODE(effSetBypass),
        OPCODE(effGetEffectName),
        OPCODE(effGetVendorString),
        OPCODE(effGetProductString),
        OPCODE(effGetVendorVersion),
        OPCODE(effVendorSpecific),
        OPCODE(effCanDo),
        OPCODE(effGetTailSize),
        OPCODE(effIdle),
        OPCODE(effGetParameterProperties),
        OPCODE(effGetVstVersion),
        OPCODE(effSetEditKnobMode),
        OPCODE(effBeginSetProgram),
        OPCODE(effEndSetProgram),
        OPCODE(effGetSpeakerArrangement),
        OPCODE(effShellGetNextPlugin),
        OPCODE(effStartProcess),
        OPCODE(effStopProcess),
        OPCODE(effBeginLoadBank),
        OPCODE(effBeginLoadProgram),
        OPCODE(effSetProcessPrecision),
    };
#undef OPCODE
    return sNames;
}

} // namespace

std::string OpcodeName(int opcode)
{
    const auto found = OpcodeNames().find(opcode);
    return found == OpcodeNames().end() ? std::to_string(opcode) : found->second;
}

FakeEffect::FakeEffect()
{
    effect.magic = kEffectMagic;
    effect.dispatcher = Dispatch;
    effect.process = Accumulate;
    effect.processReplacing = Replace;
    effect.setParameter = SetParameter;
    effect.getParameter = GetParameter;
    effect.numInputs = 2;
    effect.numOutputs = 2;
    effect.flags = effFlagsCanReplacing;
    effect.ioRatio = 1.0F;
    effect.object = this;
    effect.uniqueID = 1234;
    effect.version = 1;
    Return(effGetVstVersion, 2400);
}

void FakeEffect::On(AEffectOpcodes opcode, Answer answer)
{
    mAnswers[opcode] = std::move(answer);
}

void FakeEffect::Return(AEffectOpcodes opcode, long long result)
{
    On(opcode, [result](int, long long, void*, float) { return result; });
}

void FakeEffect::Text(AEffectOpcodes opcode, const std::string& text)
{
    On(opcode,
       [text](int, long long, void* ptr, float)
       {
           std::memcpy(ptr, text.c_str(), text.size() + 1);
           return 1LL;
       });
}

void FakeEffect::Throw(AEffectOpcodes opcode)
{
    On(opcode, [opcode](int, long long, void*, float) -> long long { throw std::runtime_error(OpcodeName(opcode)); });
}

long long FakeEffect::CallHost(AudioMasterOpcodes opcode, int index, long long value, void* ptr, float opt)
{
    return host ? host(&effect, opcode, index, value, ptr, opt) : 0;
}

std::vector<Call> FakeEffect::Calls() const
{
    const std::lock_guard lock(mMutex);
    return mCalls;
}

std::vector<Call> FakeEffect::CallsTo(std::string_view name) const
{
    std::vector<Call> calls = Calls();
    std::erase_if(calls, [name](const Call& call) { return call.name != name; });
    return calls;
}

std::vector<std::string> FakeEffect::Names() const
{
    std::vector<std::string> names;
    for (const Call& call : Calls())
        names.push_back(call.name);
    return names;
}

std::size_t FakeEffect::Count(std::string_view name) const
{
    return CallsTo(name).size();
}

void FakeEffect::ClearCalls()
{
    const std::lock_guard lock(mMutex);
    mCalls.clear();
}

void FakeEffect::Record(Call call)
{
    const std::lock_guard lock(mMutex);
    if (mWasClosed)
        ++callsAfterClose;
    if (recording)
        mCalls.push_back(std::move(call));
}

float& FakeEffect::ParameterAt(int index)
{
    const auto place = static_cast<std::size_t>(index);
    if (place >= parameters.size())
        parameters.resize(place + 1);
    return parameters[place];
}

long long FakeEffect::Dispatch(AEffect* self, std::int32_t opcode, std::int32_t index, long long value, void* ptr,
                               float opt)
{
    FakeEffect& fake = SelfOf(self);
    fake.Record({OpcodeName(opcode), opcode, index, value, ptr, opt});
    if (opcode == effOpen)
        fake.isOpen = true;
    const auto answer = fake.mAnswers.find(opcode);
    const long long result = answer == fake.mAnswers.end() ? 0 : answer->second(index, value, ptr, opt);
    if (opcode == effClose)
    {
        fake.isOpen = false;
        fake.mWasClosed = true;
    }
    return result;
}

void FakeEffect::Accumulate(AEffect* self, float** inputs, float** outputs, std::int32_t frames)
{
    FakeEffect& fake = SelfOf(self);
    fake.Record({"process", -1, 0, frames});
    if (fake.accumulate)
        return fake.accumulate(inputs, outputs, frames);
    for (int pin = 0; pin < std::min(self->numInputs, self->numOutputs); ++pin)
        for (int frame = 0; frame < frames; ++frame)
            outputs[pin][frame] += inputs[pin][frame];
}

void FakeEffect::Replace(AEffect* self, float** inputs, float** outputs, std::int32_t frames)
{
    FakeEffect& fake = SelfOf(self);
    fake.Record({"processReplacing", -1, 0, frames});
    if (fake.replace)
        return fake.replace(inputs, outputs, frames);
    for (int pin = 0; pin < self->numOutputs; ++pin)
        for (int frame = 0; frame < frames; ++frame)
            outputs[pin][frame] = pin < self->numInputs ? inputs[pin][frame] : 0.0F;
}

void FakeEffect::SetParameter(AEffect* self, std::int32_t index, float value)
{
    FakeEffect& fake = SelfOf(self);
    fake.Record({"setParameter", -1, index, 0, nullptr, value});
    fake.ParameterAt(index) = value;
    if (fake.onSet)
        fake.onSet(index, value);
}

float FakeEffect::GetParameter(AEffect* self, std::int32_t index)
{
    FakeEffect& fake = SelfOf(self);
    fake.Record({"getParameter", -1, index});
    return fake.ParameterAt(index);
}

} // namespace fakeeffect
