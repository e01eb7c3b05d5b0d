// A VST 2 plug-in inside the test: it answers as its script says and writes down what the host calls, in order.
#pragma once

#include "host/src/VST/interface/VST2Interface.h"

#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

namespace fakeeffect
{

using namespace zebaudiofilterhost::vst;

// One call of the host: of the dispatcher under the opcode's name, of the other functions under their own.
struct Call
{
    std::string name;
    int opcode = -1;     // -1: not the dispatcher
    int index = 0;       // of setParameter and getParameter too
    long long value = 0; // frames, for the process functions
    void* ptr = nullptr;
    float opt = 0; // of setParameter too
};

// The script and the log. Must outlive the filter made of it: after effClose it counts what is still called.
class FakeEffect
{
public:
    using Answer = std::function<long long(int index, long long value, void* ptr, float opt)>;
    using Render = std::function<void(float** inputs, float** outputs, int frames)>;

    // Stereo to stereo, replacing, version 2400, ID 1234, no parameters, no programs, no editor, no texts.
    FakeEffect();
    FakeEffect(const FakeEffect&) = delete;
    FakeEffect& operator=(const FakeEffect&) = delete;

    AEffect* Get() { return &effect; }
    // What `Get` points to: set its fields before a filter is made of it.
    AEffect effect = {};

    // What an opcode answers; an unscripted one answers 0.
    void On(AEffectOpcodes opcode, Answer answer);
    void Return(AEffectOpcodes opcode, long long result);
    // Writes a text with its terminator to `ptr`, and answers 1.
    void Text(AEffectOpcodes opcode, const std::string& text);
    void Throw(AEffectOpcodes opcode);

    // Copies inputs to outputs while empty; pins beyond the inputs become silent. `accumulate` is AEffect::process.
    Render replace;
    Render accumulate;

    // What setParameter does when the value is there.
    std::function<void(int index, float value)> onSet;

    // One value for each of effect.numParams; grows at need.
    std::vector<float> parameters;

    // Calls the host as a plug-in would; 0 without a host.
    audioMasterCallback host = nullptr;
    long long CallHost(AudioMasterOpcodes opcode, int index = 0, long long value = 0, void* ptr = nullptr,
                       float opt = 0);

    std::vector<Call> Calls() const;
    std::vector<Call> CallsTo(std::string_view name) const;
    // Of all calls, in order.
    std::vector<std::string> Names() const;
    std::size_t Count(std::string_view name) const;
    void ClearCalls();
    bool recording = true;

    bool isOpen = false;     // between effOpen and effClose
    int callsAfterClose = 0; // a real plug-in would be gone

private:
    static long long Dispatch(AEffect* self, std::int32_t opcode, std::int32_t index, long long value, void* ptr,
                              float opt);
    static void Accumulate(AEffect* self, float** inputs, float** outputs, std::int32_t frames);
    static void Replace(AEffect* self, float** inputs, float** outputs, std::int32_t frames);
    static void SetParameter(AEffect* self, std::int32_t index, float value);
    static float GetParameter(AEffect* self, std::int32_t index);

    void Record(Call call);
    float& ParameterAt(int index);

    bool mWasClosed = false;
    std::map<int, Answer> mAnswers;
    mutable std::mutex mMutex;
    std::vector<Call> mCalls;
};

// "effOpen" and so on; the number as text for what has no name.
std::string OpcodeName(int opcode);

} // namespace fakeeffect
