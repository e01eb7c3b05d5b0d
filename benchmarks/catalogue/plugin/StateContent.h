#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace effects::state
{

/// The first state of the effect: bytes of every value, without a period that a block of any size would fit.
inline std::vector<char> Content(std::size_t size)
{
    std::vector<char> bytes(size);
    std::uint32_t seed = 1;
    std::generate(bytes.begin(), bytes.end(),
                  [&seed]
                  {
                      seed = seed * 1664525U + 1013904223U;
                      return static_cast<char>(seed >> 24U);
                  });
    return bytes;
}

} // namespace effects::state
