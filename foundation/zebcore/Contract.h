#pragma once

#include "foundation/zebcore/Export.h"

namespace zebcore::debug
{

/// Whether a debugger is attached to the process. Asks the system: not for the process path. [any]
ZEB_EXPORT bool IsDebuggerAttached();

/// Reports a contract violation to the developer, through DebugTrace; returns true when the program is to break into
/// the debugger. [any]
ZEB_EXPORT bool BreakAfterContractDialog(const char* expression, const char* file, const char* function, int line);

/// Reports, breaks into an attached debugger, then throws config::Error. [main]
[[noreturn]] ZEB_EXPORT void RaiseContractViolation(const char* expression, const char* file, const char* function,
                                                    int line);

} // namespace zebcore::debug

/// A precondition of the caller's; a violation throws zebcore::config::Error.
#define ZEB_CONTRACT(expression)                                                                                     \
    do                                                                                                               \
    {                                                                                                                \
        if (!(expression)) [[unlikely]]                                                                              \
            ::zebcore::debug::RaiseContractViolation(#expression, __FILE__, __func__, __LINE__);                     \
    } while (false)
