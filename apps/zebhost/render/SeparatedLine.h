#pragma once

#include <string>
#include <vector>

namespace zebhost
{

// The fields of a line, without blanks around them: separated by tabs if there is one, otherwise by commas. Text in
// double quotes keeps its separators; two quotes there stand for one.
std::vector<std::string> SplitSeparatedLine(const std::string& line);

} // namespace zebhost
