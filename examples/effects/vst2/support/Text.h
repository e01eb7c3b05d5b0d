#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace effects::vst2
{

// What the interface allows for each text, with the zero at its end.
constexpr std::size_t kParameterLength = 8;
constexpr std::size_t kProgramLength = 24;
constexpr std::size_t kNameLength = 32;
constexpr std::size_t kVendorLength = 64;

// Writes at most `length` bytes, the last of which is a zero.
void CopyText(void* target, std::string_view text, std::size_t length);

// "12.5" whatever the locale; the number that a text begins with.
std::string Decimal(float value, int decimals);
std::optional<float> Number(std::string_view text);

} // namespace effects::vst2
