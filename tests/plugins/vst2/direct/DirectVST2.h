#pragma once

#include "host/src/VST/interface/VST2Interface.h"

#include <filesystem>
#include <string>
#include <vector>

namespace zebtest
{

using VST2Channels = std::vector<std::vector<float>>;

// One VST 2 plug-in, called as the interface says and without anything of ours in between: tests learn from it what
// the plug-in itself does.
class DirectVST2
{
public:
    // `member` is the unique ID that a shell gets when it asks which member is wanted. `effect` is null if the
    // plug-in makes none. Throws std::runtime_error if there is no such file or entry point.
    explicit DirectVST2(const std::filesystem::path& path, std::int32_t member = 0);
    ~DirectVST2();
    DirectVST2(const DirectVST2&) = delete;
    DirectVST2& operator=(const DirectVST2&) = delete;

    long long Call(std::int32_t opcode, std::int32_t index = 0, long long value = 0, void* ptr = nullptr,
                   float opt = 0.0F);
    std::string Text(std::int32_t opcode, std::int32_t index = 0);
    bool Arrange(std::int32_t type, std::int32_t channels);
    std::string Chunk(bool ofProgram);
    bool SetChunk(bool ofProgram, std::string bytes);
    void Resume(float sampleRate, int blockSize);

    // One call of processReplacing. The result has as many channels as the plug-in has outputs.
    VST2Channels Process(VST2Channels input);

    zebaudiofilterhost::vst::AEffect* effect = nullptr;
    std::vector<std::string> told; // "begin 0", "automate 0", "end 0", "size 540 210"
    float lastValue = -1.0F;       // of an automation
    bool canResize = true;         // what audioMasterSizeWindow is answered

private:
    static long long HostCallback(zebaudiofilterhost::vst::AEffect* effect, std::int32_t opcode, std::int32_t index,
                                  long long value, void* ptr, float opt);
    long long Answer(std::int32_t opcode, std::int32_t index, long long value, float opt);
};

} // namespace zebtest
