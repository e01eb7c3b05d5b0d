#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace effects::vst2
{

enum EchoParameter : std::int32_t
{
    kTime,     // 0 to 1000 ms
    kFeedback, // %
    kMix,      // %
    kEchoParameterCount
};

using EchoValues = std::array<float, kEchoParameterCount>; // 0 to 1

struct EchoProgram
{
    const char* name;
    EchoValues values;
};

// Programs are numbered in the order of this table.
std::span<const EchoProgram> EchoPrograms();

// What the plug-in keeps in a chunk: the values of one program, or of all with the number of the current one in
// front. Integers and floats of 32 bits in this machine's order behind four characters that say what it is.
std::vector<std::byte> WriteEchoChunk(std::span<const EchoValues> programs, std::int32_t current);

// False, and nothing changes, if the bytes are of another kind or not as many as they have to be.
bool ReadEchoChunk(std::span<const std::byte> chunk, std::span<EchoValues> programs, std::int32_t& current);

} // namespace effects::vst2
