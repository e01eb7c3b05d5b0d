#pragma once

#include "cli/CommandTable.h"

#include <string>
#include <string_view>

namespace zebhost
{

// `width` is that of the terminal.
std::string OverviewHelp(std::size_t width);
std::string CommandHelp(const CommandSpec& command, std::size_t width);
// Help for whatever was named: a command, the first word of several, or nothing.
std::string HelpFor(std::string_view command, std::size_t width);

// "zebhost render [OPTIONS] FILTER FILE..."
std::string UsageLine(const CommandSpec& command);
// "--set NAME=TEXT"
std::string OptionSignature(const OptionSpec& option);

} // namespace zebhost
