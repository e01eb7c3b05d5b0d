#pragma once

#include <string>

namespace zebhost
{

// "[#####-----] 12/24 Name", of a fixed width in front of the name.
std::string ProgressBar(long long done, long long total, const std::string& name);

} // namespace zebhost
