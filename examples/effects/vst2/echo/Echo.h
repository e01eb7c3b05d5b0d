#pragma once

#include "examples/effects/vst2/echo/EchoPrograms.h"
#include "examples/effects/vst2/support/Effect.h"

#include <array>

namespace effects::vst2
{

// An echo of up to a second, with programs, that keeps its state in chunks.
class Echo final : public Effect
{
public:
    explicit Echo(audioMasterCallback host);

protected:
    void Process(const float* const* inputs, float* const* outputs, std::int32_t frames) override;
    void Start() override;
    std::string Display(std::int32_t index) const override;
    std::optional<float> Read(std::int32_t index, const std::string& text) const override;
    long long Answer(const Call& call) override;

private:
    void ProcessChannel(std::size_t channel, const float* input, float* output, std::int32_t frames);
    long long NameProgram(long long program, void* name) const;
    void SelectProgram(long long program);
    void TakeValues();
    void KeepValues();
    long long GetChunk(bool isProgram, void** chunk);
    long long SetChunk(bool isProgram, std::span<const std::byte> chunk);
    std::size_t DelayFrames() const;
    long long TailFrames() const;

    std::vector<EchoValues> mPrograms; // the main thread's alone; that of the current one lags behind the parameters
    std::int32_t mProgram = 0;
    std::vector<std::byte> mChunk; // what the host was given last; it copies it
    std::array<std::vector<float>, 2> mLines;
    std::array<std::size_t, 2> mPositions{};
};

} // namespace effects::vst2
