#include "cli/ExitCode.h"

namespace zebhost
{

const char* ExitCodeName(ExitCode code)
{
    switch (code)
    {
    case ExitCode::Done:
        return "done";
    case ExitCode::JobFailed:
        return "job-failed";
    case ExitCode::Usage:
        return "usage";
    case ExitCode::NotFound:
        return "not-found";
    case ExitCode::NotLoaded:
        return "not-loaded";
    case ExitCode::Crashed:
        return "crashed";
    case ExitCode::Blocked:
        return "blocked";
    case ExitCode::FileTrouble:
        return "file";
    }
    return "unknown";
}

} // namespace zebhost
