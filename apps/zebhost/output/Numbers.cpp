#include "output/Numbers.h"

#include "output/Strings.h"

#include <array>
#include <charconv>
#include <cmath>

namespace zebhost
{

std::optional<double> ParseNumber(std::string_view text)
{
    text = Trimmed(text);
    if (text.size() > 1 && text.front() == '+' && text[1] != '-')
    {
        text.remove_prefix(1);
    }
    double value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (text.empty() || error != std::errc() || end != text.data() + text.size() || std::isnan(value))
    {
        return std::nullopt;
    }
    return value;
}

std::string FixedNumber(double value, int decimals)
{
    std::array<char, 400> buffer{};
    const auto [end, error] =
        std::to_chars(buffer.data(), buffer.data() + buffer.size(), value, std::chars_format::fixed, decimals);
    return error == std::errc() ? std::string(buffer.data(), end) : ShortNumber(value);
}

std::string ShortNumber(double value)
{
    std::array<char, 64> buffer{};
    const auto [end, error] = std::to_chars(buffer.data(), buffer.data() + buffer.size(), value);
    return error == std::errc() ? std::string(buffer.data(), end) : std::string();
}

} // namespace zebhost
