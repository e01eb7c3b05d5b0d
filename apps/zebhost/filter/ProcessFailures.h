#pragma once

#include <string>

namespace zebhost
{

// While one lives, it hears when the library says that a plug-in's call for a block has failed: the sound of the
// block is then whatever the plug-in has left of it. The library says so of a plug-in's first failure alone, and for
// Audio Units of the process's first. One at a time. [main]
class ProcessFailures
{
public:
    ProcessFailures();
    ~ProcessFailures();
    ProcessFailures(const ProcessFailures&) = delete;
    ProcessFailures& operator=(const ProcessFailures&) = delete;

    // What the library said, such as "failed with result: 1"; empty if nothing.
    const std::string& First() const { return mFirst; }

private:
    std::string mFirst;
};

} // namespace zebhost
