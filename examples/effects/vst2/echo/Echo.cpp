// ZebEcho2: programs and chunks.
#include "examples/effects/vst2/echo/Echo.h"

#include "examples/effects/vst2/support/Text.h"

#include <algorithm>
#include <cmath>

namespace effects::vst2
{

namespace
{

constexpr float kLongest = 1000.0F; // ms

} // namespace

Echo::Echo(audioMasterCallback host)
    : Effect(host, {.uniqueID = FourCharacters("ZbEc"),
                    .name = "Zeb Echo 2",
                    .category = kPlugCategRoomFx,
                    .parameters = {{"Time", "ms", 0.0F}, {"Feedbk", "%", 0.0F}, {"Mix", "%", 0.0F}},
                    .flags = effFlagsProgramChunks})
{
    for (const EchoProgram& program : EchoPrograms())
        mPrograms.push_back(program.values);
    SetProgramCount(static_cast<std::int32_t>(mPrograms.size()));
    TakeValues();
}

// The parameters become those of the current program.
void Echo::TakeValues()
{
    const EchoValues values = mPrograms[static_cast<std::size_t>(mProgram)];
    for (std::int32_t i = 0; i < kEchoParameterCount; ++i)
        SetParameter(i, values[static_cast<std::size_t>(i)]);
}

// The other way round, ahead of whatever looks at the programs: parameters may be set on the audio thread at any
// time.
void Echo::KeepValues()
{
    EchoValues& values = mPrograms[static_cast<std::size_t>(mProgram)];
    for (std::int32_t i = 0; i < kEchoParameterCount; ++i)
        values[static_cast<std::size_t>(i)] = Get(i);
}

std::string Echo::Display(std::int32_t index) const
{
    return index == kTime ? Decimal(kLongest * Get(kTime), 1) : Effect::Display(index);
}

std::optional<float> Echo::Read(std::int32_t index, const std::string& text) const
{
    const auto number = Number(text);
    return number ? std::optional(std::clamp(*number / (index == kTime ? kLongest : 100.0F), 0.0F, 1.0F))
                  : std::nullopt;
}

void Echo::Start()
{
    const auto length = static_cast<std::size_t>(SampleRate() * kLongest / 1000.0F) + 1;
    for (std::vector<float>& line : mLines)
        line.assign(length, 0.0F);
    mPositions = {};
}

std::size_t Echo::DelayFrames() const
{
    const auto frames = static_cast<std::size_t>(SampleRate() * Get(kTime) * kLongest / 1000.0F);
    return std::clamp(frames, std::size_t{1}, mLines.front().size() - 1);
}

void Echo::Process(const float* const* inputs, float* const* outputs, std::int32_t frames)
{
    for (std::size_t channel = 0; channel < mLines.size(); ++channel)
        ProcessChannel(channel, inputs[channel], outputs[channel], frames);
}

void Echo::ProcessChannel(std::size_t channel, const float* input, float* output, std::int32_t frames)
{
    std::vector<float>& line = mLines[channel];
    std::size_t& position = mPositions[channel];
    const std::size_t delay = DelayFrames();
    const float feedback = Get(kFeedback);
    const float mix = Get(kMix);
    for (std::int32_t i = 0; i < frames; ++i)
    {
        const float in = input[i];
        const float echo = line[(position + line.size() - delay) % line.size()];
        line[position] = in + feedback * echo;
        position = (position + 1) % line.size();
        output[i] = in + mix * (echo - in);
    }
}

// Until the echoes are 60 dB down. 1 says that there is no tail, 0 that it is not known.
long long Echo::TailFrames() const
{
    if (Get(kMix) <= 0.0F)
        return 1;
    const float feedback = std::min(Get(kFeedback), 0.99F);
    const float echoes = feedback <= 0.0F ? 1.0F : std::ceil(-3.0F / std::log10(feedback));
    return static_cast<long long>(SampleRate() * Get(kTime) * kLongest / 1000.0F * echoes);
}

long long Echo::NameProgram(long long program, void* name) const
{
    if (program < 0 || program >= static_cast<long long>(EchoPrograms().size()))
        return 0;
    CopyText(name, EchoPrograms()[static_cast<std::size_t>(program)].name, kProgramLength);
    return 1;
}

void Echo::SelectProgram(long long program)
{
    if (program < 0 || program >= static_cast<long long>(mPrograms.size()))
        return;
    KeepValues();
    mProgram = static_cast<std::int32_t>(program);
    TakeValues();
}

long long Echo::GetChunk(bool isProgram, void** chunk)
{
    KeepValues();
    const std::span<const EchoValues> all(mPrograms);
    mChunk = WriteEchoChunk(isProgram ? all.subspan(static_cast<std::size_t>(mProgram), 1) : all, mProgram);
    *chunk = mChunk.data();
    return static_cast<long long>(mChunk.size());
}

// A program's chunk goes into the program that is current here, whichever it was taken from.
long long Echo::SetChunk(bool isProgram, std::span<const std::byte> chunk)
{
    KeepValues();
    std::int32_t current = 0;
    const std::span<EchoValues> all(mPrograms);
    const std::span<EchoValues> target = isProgram ? all.subspan(static_cast<std::size_t>(mProgram), 1) : all;
    if (!ReadEchoChunk(chunk, target, current))
        return 0;
    if (!isProgram)
        mProgram = current;
    TakeValues();
    return 1;
}

long long Echo::Answer(const Call& call)
{
    switch (call.opcode)
    {
    case effSetProgram:
        SelectProgram(call.value);
        return 0;
    case effGetProgram:
        return mProgram;
    case effGetProgramName:
        return NameProgram(mProgram, call.ptr);
    case effGetProgramNameIndexed:
        return NameProgram(call.index, call.ptr);
    case effGetChunk:
        return GetChunk(call.index != 0, static_cast<void**>(call.ptr));
    case effSetChunk:
        return call.ptr == nullptr || call.value < 0
                   ? 0
                   : SetChunk(call.index != 0,
                              {static_cast<const std::byte*>(call.ptr), static_cast<std::size_t>(call.value)});
    case effGetTailSize:
        return TailFrames();
    default:
        return 0;
    }
}

std::unique_ptr<Effect> MakeEffect(audioMasterCallback host)
{
    return std::make_unique<Echo>(host);
}

} // namespace effects::vst2
