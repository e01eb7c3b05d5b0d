#pragma once

#include "cli/ExitCode.h"

#include <stdexcept>
#include <string>

namespace zebhost
{

// Ends a command. The message is the last line on stderr: what happened, to which file, and what to do.
class Failure : public std::runtime_error
{
public:
    Failure(ExitCode code, const std::string& message) : std::runtime_error(message), mCode(code) {}

    ExitCode Code() const { return mCode; }

private:
    ExitCode mCode;
};

} // namespace zebhost
