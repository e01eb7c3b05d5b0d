#pragma once

#include <string>

namespace zebhost
{

// The manual page in man's own macros, made from the command table.
std::string ManPage(const std::string& version);

} // namespace zebhost
