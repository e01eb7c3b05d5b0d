#pragma once

#include "host/src/VST/interface/VST2Interface.h"

#include <atomic>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace effects::vst2
{

using namespace zebaudiofilterhost::vst;

struct Parameter
{
    const char* name = nullptr;  // 7 bytes at most, as is `label`
    const char* label = nullptr; // of the unit
    float initial = 0.0F;        // 0 to 1, as all values
    std::int32_t flags = kVstParameterCanRamp;
};

struct Description
{
    std::int32_t uniqueID;
    const char* name;
    VstPlugCategory category;
    std::vector<Parameter> parameters{};
    std::int32_t flags = 0; // beside effFlagsCanReplacing
};

// Four characters as the interface numbers plug-ins.
constexpr std::int32_t FourCharacters(const char (&text)[5])
{
    return text[0] << 24 | text[1] << 16 | text[2] << 8 | text[3];
}

// One call of the host's, as the dispatcher gets it.
struct Call
{
    std::int32_t opcode;
    std::int32_t index;
    long long value;
    void* ptr;
    float opt;
};

// One instance, with the usual answers: an effect adds what it does with samples and with text. Stereo unless it says
// otherwise, with one program that has no name.
class Effect
{
public:
    Effect(audioMasterCallback host, Description description);
    virtual ~Effect() = default;
    Effect(const Effect&) = delete;
    Effect& operator=(const Effect&) = delete;

    AEffect* Binary() { return &mEffect; } // as the host knows it

protected:
    // Replaces the outputs. The host may change parameters meanwhile, from another thread.
    virtual void Process(const float* const* inputs, float* const* outputs, std::int32_t frames) = 0;
    virtual void Start() {} // before sound comes: forget what was
    virtual std::string Display(std::int32_t index) const;
    virtual std::optional<float> Read(std::int32_t index, const std::string& text) const;
    virtual void SetParameter(std::int32_t index, float value);

    // For opcodes that only some effects answer. 0: not answered.
    virtual long long Answer(const Call& call);

    float Get(std::int32_t index) const;
    float SampleRate() const { return mSampleRate; }
    void SetChannels(std::int32_t inputs, std::int32_t outputs);
    void SetProgramCount(std::int32_t count) { mEffect.numPrograms = count; }
    long long AskHost(std::int32_t opcode, std::int32_t index, long long value, void* ptr, float opt);

private:
    static long long Dispatch(AEffect* effect, std::int32_t opcode, std::int32_t index, long long value, void* ptr,
                              float opt);
    static void ProcessReplacing(AEffect* effect, float** inputs, float** outputs, std::int32_t frames);
    static void SetParameterProc(AEffect* effect, std::int32_t index, float value);
    static float GetParameterProc(AEffect* effect, std::int32_t index);
    static Effect& Of(AEffect* effect) { return *static_cast<Effect*>(effect->object); }

    long long AnswerText(const Call& call) const;
    long long AnswerParameter(const Call& call);
    long long AnswerUsual(const Call& call);
    long long Describe(std::int32_t index, VstParameterProperties& properties) const;
    bool IsParameter(std::int32_t index) const { return index >= 0 && index < mEffect.numParams; }

    AEffect mEffect{};
    audioMasterCallback mHost;
    Description mDescription;
    std::vector<std::atomic<float>> mValues;
    float mSampleRate = 44100.0F;
};

// Written by each plug-in: a new instance, or null if there is none.
std::unique_ptr<Effect> MakeEffect(audioMasterCallback host);

} // namespace effects::vst2
