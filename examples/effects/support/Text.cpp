#include "examples/effects/support/Text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

namespace effects
{

void CopyText(std::u16string_view text, String128 target)
{
    const std::size_t length = std::min<std::size_t>(text.size(), 127);
    std::copy_n(text.data(), length, target);
    target[length] = 0;
}

std::u16string NumberText(double value, int decimals)
{
    const double unit = std::pow(10.0, -decimals);
    if (std::abs(value) < unit / 2)
        value = 0.0; // no "-0.0"
    std::array<char, 400> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), value, std::chars_format::fixed, decimals);
    return {text.data(), end.ptr};
}

std::optional<double> ParseNumber(std::u16string_view text)
{
    text.remove_prefix(std::min(text.find_first_not_of(u' '), text.size()));
    if (text.starts_with(u'+'))
        text.remove_prefix(1);
    std::string ascii;
    for (const char16_t unit : text.substr(0, 64))
        ascii += unit < 128 ? static_cast<char>(unit) : '?';
    double value = 0.0;
    const auto result = std::from_chars(ascii.data(), ascii.data() + ascii.size(), value, std::chars_format::fixed);
    if (result.ec != std::errc() || !std::isfinite(value))
        return std::nullopt;
    return value;
}

} // namespace effects
