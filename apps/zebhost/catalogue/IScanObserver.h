#pragma once

#include <host/PluginLocator.h>

#include <string>

namespace zebhost
{

// Told of what a scan does, between its steps.
class IScanObserver
{
public:
    enum class End
    {
        Scanned,
        Failed,  // could not be loaded
        Crashed, // the three below: it ended the worker process; this and the next block it
        TimedOut,
        Interrupted // somebody else ended the worker, so it is not blocked
    };

    struct Outcome
    {
        bool loaded = false;
        std::size_t effects = 0;
        std::string problem; // why it could not be loaded
        End end = End::Scanned;
    };

    virtual ~IScanObserver() = default;
    // `current` counts from 1. `detail` tells the filter of a plug-in that has several.
    virtual void Stepping(const zebaudiofilterhost::PluginLocator& locator, const std::string& detail,
                          std::size_t current, std::size_t total) = 0;
    virtual void Finished(const zebaudiofilterhost::PluginLocator& locator, const Outcome& outcome) = 0;
    // Asked again and again.
    virtual bool ShallStop() const = 0;
};

} // namespace zebhost
