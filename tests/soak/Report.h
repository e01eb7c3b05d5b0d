#pragma once

#include "Console.h"
#include "Options.h"
#include "Soak.h"

namespace soak
{

/// The verdict, with what has grown most.
void SayFindings(const Console& console, const Findings& findings);

/// Writes all that was found to the file of the options, if there is one.
void WriteJson(const Options& options, const Findings& findings);

} // namespace soak
