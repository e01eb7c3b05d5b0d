#pragma once

#include <string>
#include <vector>

namespace zebhost
{

// Switches the library's trace categories on, "all" for every one. The lines go to standard error.
void StartTracing(const std::vector<std::string>& categories);

} // namespace zebhost
