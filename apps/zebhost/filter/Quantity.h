#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace zebhost
{

// A number with its unit, as a parameter displays it: "-6.00 dB", "1.2 kHz", "-inf dB", "50 %".
struct Quantity
{
    double value = 0;      // in the base unit, so that 1.2 kHz is 1200
    std::string unit;      // in lower case, "khz"; empty if none stood there
    double resolution = 0; // half of what the last digit is worth, in the base unit
};

// Reads the number at the head of the text. A text without a unit is read in `defaultUnit`. Nothing for a text that
// does not begin with a number.
std::optional<Quantity> ParseQuantity(std::string_view text, std::string_view defaultUnit);

} // namespace zebhost
