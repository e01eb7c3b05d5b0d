#include "examples/effects/vst2/echo/EchoPrograms.h"

#include <algorithm>
#include <cmath>
#include <cstring>

namespace effects::vst2
{

namespace
{

constexpr std::array<EchoProgram, 4> kPrograms{{
    {"Slap", {0.09F, 0.0F, 0.3F}},
    {"Eighths", {0.25F, 0.35F, 0.35F}},
    {"Canyon", {0.8F, 0.6F, 0.4F}},
    {"Comb", {0.01F, 0.8F, 0.5F}},
}};

constexpr std::array<char, 4> kKind{'Z', 'E', 'c', '2'};

struct Head
{
    std::array<char, 4> kind;
    std::int32_t current;
};

// A value from elsewhere: also none at all.
float Sane(float value)
{
    return std::isfinite(value) ? std::clamp(value, 0.0F, 1.0F) : 0.0F;
}

} // namespace

std::span<const EchoProgram> EchoPrograms()
{
    return kPrograms;
}

std::vector<std::byte> WriteEchoChunk(std::span<const EchoValues> programs, std::int32_t current)
{
    const Head head{kKind, current};
    std::vector<std::byte> chunk(sizeof(head) + programs.size_bytes());
    std::memcpy(chunk.data(), &head, sizeof(head));
    std::memcpy(chunk.data() + sizeof(head), programs.data(), programs.size_bytes());
    return chunk;
}

bool ReadEchoChunk(std::span<const std::byte> chunk, std::span<EchoValues> programs, std::int32_t& current)
{
    Head head{};
    if (chunk.size() != sizeof(head) + programs.size_bytes())
        return false;
    std::memcpy(&head, chunk.data(), sizeof(head));
    if (head.kind != kKind || head.current < 0 || head.current >= static_cast<std::int32_t>(kPrograms.size()))
        return false;
    std::memcpy(programs.data(), chunk.data() + sizeof(head), programs.size_bytes());
    for (EchoValues& values : programs)
        std::transform(values.begin(), values.end(), values.begin(), Sane);
    current = head.current;
    return true;
}

} // namespace effects::vst2
