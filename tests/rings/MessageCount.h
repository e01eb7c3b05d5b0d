#pragma once

#include <cstdint>
#include <cstdlib>

namespace zebaudiofilterhost::testing
{

/// How many messages go through each ring: what the environment says in ZEB_RING_MESSAGES, else few.
inline std::uint64_t GetMessageCount()
{
    constexpr std::uint64_t kFew = 50000;
    const char* const text = std::getenv("ZEB_RING_MESSAGES");
    return text == nullptr ? kFew : std::strtoull(text, nullptr, 10);
}

} // namespace zebaudiofilterhost::testing
