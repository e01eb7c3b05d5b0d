#pragma once

namespace zebhost
{

// What the process returns. Scripts rely on the numbers.
enum class ExitCode : int
{
    Done = 0,
    JobFailed = 1,
    Usage = 2,
    NotFound = 3, // or ambiguous
    NotLoaded = 4,
    Crashed = 5, // or timed out
    Blocked = 6,
    FileTrouble = 7 // the file exists already, or cannot be read or written
};

// A stable word for each code, as it stands in JSON output.
const char* ExitCodeName(ExitCode code);

} // namespace zebhost
