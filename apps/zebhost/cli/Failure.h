#pragma once

#include "cli/ExitCode.h"

#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace zebhost
{

// Ends a command. The message is the last line on stderr: what happened, to which file, and what to do. Details, such
// as the candidates of a choice, stand above it, a line each.
class Failure : public std::runtime_error
{
public:
    Failure(ExitCode code, const std::string& message, std::vector<std::string> details = {})
        : std::runtime_error(message), mCode(code), mDetails(std::move(details))
    {
    }

    ExitCode Code() const { return mCode; }
    const std::vector<std::string>& Details() const { return mDetails; }

private:
    ExitCode mCode;
    std::vector<std::string> mDetails;
};

} // namespace zebhost
