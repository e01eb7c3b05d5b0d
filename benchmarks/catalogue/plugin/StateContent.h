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
    std::uint32_t state = 1;
    std::generate(bytes.begin(), bytes.end(),
                  [&state]
                  {
                      state = state * 1664525U + 1013904223U;
                      return static_cast<char>(state >> 24U);
                  });
    return bytes;
}

} // namespace effects::state
