#pragma once

#include "cli/Arguments.h"

namespace zebhost
{

// Reads the command line by the command table. With --help or --version the arguments hold "help" or "version", and
// the command as far as one was named. Throws a usage Failure for anything the table does not know.
Arguments ParseArguments(int argc, const char* const* argv);

} // namespace zebhost
