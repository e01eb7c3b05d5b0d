#pragma once

#include "cli/CommandTable.h"

#include <vector>

namespace zebhost
{

// The rows of the command table, by subject.
std::vector<CommandSpec> CatalogueCommands();
std::vector<CommandSpec> RenderCommands();
std::vector<CommandSpec> PresetCommands();
std::vector<CommandSpec> EditorCommands();
std::vector<CommandSpec> BlockCommands();
std::vector<CommandSpec> ShellCommands();

// What several commands share.
OperandSpec FilterOperand();
std::vector<OptionSpec> ParameterOptions();

} // namespace zebhost
