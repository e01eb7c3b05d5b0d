#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace zebhost
{

// Small text services. Letters are folded from A to Z only, so that results do not depend on a locale.

std::string_view Trimmed(std::string_view text);
std::string Lowered(std::string_view text);
bool EqualIgnoringCase(std::string_view a, std::string_view b);
bool ContainsIgnoringCase(std::string_view text, std::string_view part);
bool StartsWithIgnoringCase(std::string_view text, std::string_view start);
// Empty pieces included: "a,,b" has three.
std::vector<std::string> Split(std::string_view text, char separator);
// With a blank for each control character, so that it stays in its line and steers no terminal.
std::string InOneLine(std::string text);
std::string Joined(const std::vector<std::string>& pieces, std::string_view separator);
// "1 effect", "2 effects".
std::string Counted(std::size_t count, std::string_view noun);

} // namespace zebhost
