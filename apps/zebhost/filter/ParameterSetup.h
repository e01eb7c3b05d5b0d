#pragma once

#include "commands/CommandContext.h"
#include "filter/LoadFilter.h"

namespace zebhost
{

// Brings a suspended filter to the settings that --preset, --set and --norm ask for, in this order, and serves the
// plug-in's timers in between. Throws a Failure for anything that does not fit.
void ApplyParameterOptions(const CommandContext& context, zebaudiofilterhost::AudioFilter& filter,
                           unsigned int settleMs = kDefaultSettleMs);

// A preset of the store, a file, or one of the plug-in's own.
void ApplyPreset(const CommandContext& context, zebaudiofilterhost::AudioFilter& filter, const std::string& preset,
                 unsigned int settleMs);

} // namespace zebhost
