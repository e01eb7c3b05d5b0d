#include "examples/effects/vst2/support/Text.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace effects::vst2
{

void CopyText(void* target, std::string_view text, std::size_t length)
{
    const std::size_t count = std::min(text.size(), length - 1);
    auto* const bytes = static_cast<char*>(target);
    std::copy_n(text.begin(), count, bytes);
    bytes[count] = '\0';
}

std::string Decimal(float value, int decimals)
{
    std::array<char, 64> text{};
    const auto result =
        std::to_chars(text.data(), text.data() + text.size(), value, std::chars_format::fixed, decimals);
    return {text.data(), result.ptr};
}

std::optional<float> Number(std::string_view text)
{
    const std::size_t start = text.find_first_not_of(" +");
    float value = 0.0F;
    if (start == std::string_view::npos ||
        std::from_chars(text.data() + start, text.data() + text.size(), value).ec != std::errc())
        return std::nullopt;
    return value;
}

} // namespace effects::vst2
