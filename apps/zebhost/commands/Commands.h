#pragma once

#include "cli/ExitCode.h"
#include "commands/CommandContext.h"

namespace zebhost
{

// One function a command. They throw a Failure when they cannot do what they were asked for.

ExitCode RunScan(CommandContext& context);
ExitCode RunList(CommandContext& context);
ExitCode RunInfo(CommandContext& context);
ExitCode RunParams(CommandContext& context);
ExitCode RunRender(CommandContext& context);
ExitCode RunPresetSave(CommandContext& context);
ExitCode RunPresetLoad(CommandContext& context);
ExitCode RunPresetList(CommandContext& context);
ExitCode RunEdit(CommandContext& context);
ExitCode RunBlock(CommandContext& context);
ExitCode RunUnblock(CommandContext& context);
ExitCode RunBlocks(CommandContext& context);
ExitCode RunConsole(CommandContext& context);

// These need neither library nor catalogue.
ExitCode RunCompletion(const Arguments& arguments, Console& console);
ExitCode RunMan(const Arguments& arguments, Console& console);

} // namespace zebhost
