#pragma once

#include "utility/CommonTypes.h"

#include <initializer_list>
#include <string_view>
#include <vector>

namespace zebaudiofilterhost
{

/// The directories that an environment variable names, separated by colons, as absolute paths; if it is not set or
/// empty, the standard ones. Of these, "~/" at the start stands for the user's home, without which they are left out.
/// [main]
std::vector<Dir> GetSearchPath(const char* variable, std::initializer_list<std::string_view> standard);

} // namespace zebaudiofilterhost
