#include "foundation/zebcore/Contract.h"

#include "foundation/zebcore/StringStreams.h"
#include "foundation/zebcore/ThrowError.h"
#include "foundation/zebcore/Trace.h"

#include <csignal>

namespace zebcore::debug
{

bool BreakAfterContractDialog(const char* expression, const char* file, const char* function, int line)
{
    utility::oUTF8StringStream report;
    report << file << ':' << line << ": " << function << ": input contract violation: " << expression << '\n';
    DebugTrace(reinterpret_cast<const unsigned char*>(report.str().c_str()));
    return true;
}

void RaiseContractViolation(const char* expression, const char* file, const char* function, int line)
{
    constexpr unsigned int kContractErrorCode = 105;
    constexpr int kInputContractSubCode = 25;

    if (BreakAfterContractDialog(expression, file, function, line) && IsDebuggerAttached())
        std::raise(SIGTRAP);
    const config::ReplacementValue none;
    config::ThrowError(
        0, "$$$/zebcore/utility/Error/Contract/InputContractViolation=An input contract violation has occurred!",
        kContractErrorCode, kInputContractSubCode, true, none, none, none, none);
}

} // namespace zebcore::debug
