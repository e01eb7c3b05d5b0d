#include "filter/Quantity.h"

#include "output/Numbers.h"
#include "output/Strings.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <utility>

namespace zebhost
{

namespace
{

constexpr std::array<std::pair<std::string_view, double>, 8> kFactors = {{{"khz", 1e3},
                                                                          {"mhz", 1e6},
                                                                          {"ms", 1e-3},
                                                                          {"msec", 1e-3},
                                                                          {"us", 1e-6},
                                                                          {"\xC2\xB5s", 1e-6},
                                                                          {"\xCE\xBCs", 1e-6},
                                                                          {"k", 1e3}}};

double FactorOf(std::string_view unit)
{
    const auto found =
        std::find_if(kFactors.begin(), kFactors.end(), [unit](const auto& factor) { return factor.first == unit; });
    return found == kFactors.end() ? 1.0 : found->second;
}

struct Head
{
    double value = 0;
    int decimals = 0;
    std::size_t length = 0;
};

bool IsDigit(char letter)
{
    return letter >= '0' && letter <= '9';
}

std::optional<Head> ReadInfinity(std::string_view text, std::size_t signLength, double sign)
{
    for (const std::string_view word : {"infinity", "inf", "oo", "\xE2\x88\x9E"})
    {
        if (StartsWithIgnoringCase(text.substr(signLength), word))
        {
            return Head{sign * std::numeric_limits<double>::infinity(), 0, signLength + word.size()};
        }
    }
    return std::nullopt;
}

// A typographic minus counts like the plain one.
std::optional<Head> ReadHead(std::string_view text)
{
    constexpr std::string_view kMinus = "\xE2\x88\x92";
    double sign = 1;
    std::size_t at = 0;
    if (text.substr(0, kMinus.size()) == kMinus)
    {
        sign = -1;
        at = kMinus.size();
    }
    else if (!text.empty() && (text.front() == '-' || text.front() == '+'))
    {
        sign = text.front() == '-' ? -1 : 1;
        at = 1;
    }
    if (const std::optional<Head> infinity = ReadInfinity(text, at, sign))
    {
        return infinity;
    }
    const std::size_t begin = at;
    while (at < text.size() && IsDigit(text[at]))
    {
        ++at;
    }
    int decimals = 0;
    if (at < text.size() && (text[at] == '.' || text[at] == ',') && at + 1 < text.size() && IsDigit(text[at + 1]))
    {
        for (++at; at < text.size() && IsDigit(text[at]); ++at)
        {
            ++decimals;
        }
    }
    std::string digits(text.substr(begin, at - begin));
    std::replace(digits.begin(), digits.end(), ',', '.');
    const std::optional<double> value = ParseNumber(digits);
    return value ? std::optional<Head>(Head{sign * *value, decimals, at}) : std::nullopt;
}

std::string UnitAt(std::string_view rest)
{
    const std::string_view unit = Trimmed(rest);
    return Lowered(unit.substr(0, unit.find_first_of(" \t")));
}

} // namespace

std::optional<Quantity> ParseQuantity(std::string_view text, std::string_view defaultUnit)
{
    text = Trimmed(text);
    const std::optional<Head> head = ReadHead(text);
    if (!head)
    {
        return std::nullopt;
    }
    const std::string unit = UnitAt(text.substr(head->length));
    const double factor = FactorOf(unit.empty() ? Lowered(defaultUnit) : unit);
    return Quantity{head->value * factor, unit, 0.5 * std::pow(10.0, -head->decimals) * factor};
}

} // namespace zebhost
