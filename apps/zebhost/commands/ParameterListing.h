#pragma once

#include "commands/CommandContext.h"

#include <audiofilter/AudioFilter.h>

namespace zebhost
{

// Prints all parameters of a filter with the values that it has now, as a table or, with `document`, under its key
// "parameters". `withChoices` adds the texts of parameters that have steps. No audio may run, nor may the state of
// the plug-in be needed afterwards: some only tell a text once the parameter is set to it.
void PrintParameters(const CommandContext& context, zebaudiofilterhost::AudioFilter& filter, Json document,
                     bool withChoices);

} // namespace zebhost
