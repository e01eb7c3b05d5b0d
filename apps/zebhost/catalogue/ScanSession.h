#pragma once

#include "catalogue/Catalogue.h"

#include <host/PluginLocator.h>

#include <string>
#include <vector>

namespace zebhost
{

// Told of what a scan does, between its steps.
class IScanObserver
{
public:
    struct Outcome
    {
        bool loaded = false;
        std::size_t effects = 0;
        std::string problem; // why it could not be loaded
    };

    virtual ~IScanObserver() = default;
    // `current` counts from 1. `detail` tells the filter of a plug-in that has several.
    virtual void Stepping(const zebaudiofilterhost::PluginLocator& locator, const std::string& detail,
                          std::size_t current, std::size_t total) = 0;
    virtual void Finished(const zebaudiofilterhost::PluginLocator& locator, const Outcome& outcome) = 0;
    // Asked between two plug-ins.
    virtual bool ShallStop() const = 0;
};

// Scans plug-ins in this process, one technology at a time and one step after the other, in such a way that nothing
// is lost when one of them ends the process: a plug-in is on the block list while it is at hand, and the catalogue is
// saved after each. [main]
class ScanSession
{
public:
    struct Options
    {
        bool skipCategory = false;
        unsigned int timeoutSeconds = 0; // 0 waits for ever
    };

    // A null catalogue scans into memory only: nothing is saved, nothing blocked.
    ScanSession(Catalogue* catalogue, IScanObserver& observer, const Options& options);

    void Run(const std::vector<zebaudiofilterhost::PluginLocator>& locators);

private:
    void RunTechnology(const std::vector<zebaudiofilterhost::PluginLocator>& locators);
    // Returns what the plug-in threw, as a sentence; empty if it did not.
    std::string ScanGuarded(const zebaudiofilterhost::PluginLocator& locator);
    void ScanOne(const zebaudiofilterhost::PluginLocator& locator);
    // Returns whether the catalogue had a record of it.
    bool Announce(const zebaudiofilterhost::PluginLocator& locator);
    void Conclude(const zebaudiofilterhost::PluginLocator& locator, bool wasKnown, const std::string& thrown);

    Catalogue* mCatalogue;
    IScanObserver& mObserver;
    Options mOptions;
    std::size_t mDone = 0;
    std::size_t mTotal = 0;
};

} // namespace zebhost
