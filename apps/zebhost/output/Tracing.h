#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace zebhost
{

// Switches the library's trace categories on, "all" for every one. The lines go to standard error.
void StartTracing(const std::vector<std::string>& categories);

// Whether the user asked for it.
bool IsTracing(std::string_view category);

} // namespace zebhost
