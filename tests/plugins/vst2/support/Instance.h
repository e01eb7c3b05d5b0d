#pragma once

#include "tests/plugins/vst2/support/Behaviour.h"
#include "tests/plugins/vst2/support/CallLine.h"
#include "tests/plugins/vst2/support/HostCalls.h"
#include "tests/plugins/vst2/support/OwnThread.h"

#include <array>
#include <atomic>
#include <string>
#include <vector>

namespace vst2fixture
{

// One instance of the fixture: records what it is called for, and answers as the knobs say.
class Instance
{
public:
    // `member` is null for a plug-in that is no shell, and for the shell itself.
    Instance(audioMasterCallback host, std::int32_t uniqueID, const Member* member);
    ~Instance();
    Instance(const Instance&) = delete;
    Instance& operator=(const Instance&) = delete;

    AEffect* Effect() { return &mEffect; }
    HostAccess Host() { return {mHost, &mEffect}; }

    // The newest that is open, null for none; all take over what the knobs say now.
    static Instance* Newest();
    static void RefreshAll();

private:
    static constexpr std::size_t kMostSpeakers = 64;

    struct Arrangement
    {
        VstSpeakerArrangement head{};
        std::array<VstSpeakerProperties, kMostSpeakers>
            rest{}; // right behind it, as arrangements of many channels are
    };

    using Values = std::vector<float>;

    static long long Dispatch(AEffect* effect, std::int32_t opcode, std::int32_t index, long long value, void* ptr,
                              float opt);
    static void ProcessProc(AEffect* effect, float** inputs, float** outputs, std::int32_t frames);
    static void ProcessReplacingProc(AEffect* effect, float** inputs, float** outputs, std::int32_t frames);
    static void SetParameterProc(AEffect* effect, std::int32_t index, float value);
    static float GetParameterProc(AEffect* effect, std::int32_t index);
    static Instance& Of(AEffect* effect) { return *static_cast<Instance*>(effect->object); }

    void Refresh();
    long long Answer(const Call& call);
    long long AnswerLife(const Call& call);
    long long AnswerText(const Call& call) const;
    long long AnswerParameter(const Call& call);
    long long AnswerState(const Call& call);
    long long AnswerArrangement(const Call& call);
    long long AnswerEditor(const Call& call);
    long long AnswerShell(const Call& call);

    void Open();
    void Switch(bool on);
    long long Describe(std::int32_t index, VstParameterProperties& properties) const;
    long long GetChunk(void** chunk);
    long long SetChunk(const void* chunk, long long size);
    void TakeArrangement(const VstSpeakerArrangement* from, Arrangement& to, std::int32_t& pins) const;
    void Process(float** inputs, float** outputs, std::int32_t frames, bool adds);
    float* ValueAt(std::int32_t index);
    Values& Current() { return mPrograms[mProgram]; }

    AEffect mEffect{};
    audioMasterCallback mHost;
    const Member* mMember;
    std::vector<Values> mPrograms;         // one at least
    std::atomic<std::size_t> mProgram = 0; // set while audio runs, as values are
    std::vector<char> mChunk;
    std::array<Arrangement, 2> mArrangements;
    bool mIsArranged = false;
    ERect mRect{};
    std::size_t mNextMember = 0;
    OwnThread mThread;
};

// Copies a text to where the host wants it, or fills all of the `room` that this host has there.
void GiveText(void* target, const std::string& text, std::size_t room);

// Throws as the knob's value says: 0 not at all.
void ThrowIf(int kind);

} // namespace vst2fixture
