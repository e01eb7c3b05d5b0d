#pragma once

#include "examples/effects/support/Vst3.h"

#include <optional>
#include <string>
#include <string_view>

namespace effects
{

// Copies as much as fits and always ends with a zero unit.
void CopyText(std::u16string_view text, String128 target);

// "-3.5" for (-3.5, 1). Never depends on the locale.
std::u16string NumberText(double value, int decimals);

// The number at the head of the text, after blanks; what follows, such as a unit, is ignored. Nothing if there is
// none.
std::optional<double> ParseNumber(std::u16string_view text);

} // namespace effects
