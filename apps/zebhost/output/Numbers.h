#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace zebhost
{

// Decimal text and numbers, whatever the C locale is.

// The whole text must be a number; blanks around it are allowed.
std::optional<double> ParseNumber(std::string_view text);

// With exactly so many decimals.
std::string FixedNumber(double value, int decimals);

// The shortest text that reads back as the same number.
std::string ShortNumber(double value);

} // namespace zebhost
