#pragma once

#include <string>
#include <string_view>

namespace zebhost
{

// A completion script made from the command table. `shell` is "bash", "zsh" or "fish".
std::string ShellCompletion(std::string_view shell);

} // namespace zebhost
