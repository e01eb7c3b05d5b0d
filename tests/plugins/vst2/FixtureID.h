#pragma once

#include <cstdint>
#include <string_view>

namespace zebtest
{

// The unique ID of a VST 2 fixture, or of the first member of one that is a shell: the 32-bit FNV-1a hash of its
// name. Further members follow in steps of one.
constexpr std::uint32_t VST2FixtureID(std::string_view name)
{
    std::uint32_t hash = 2166136261U;
    for (const char letter : name)
        hash = (hash ^ static_cast<unsigned char>(letter)) * 16777619U;
    return hash;
}

} // namespace zebtest
