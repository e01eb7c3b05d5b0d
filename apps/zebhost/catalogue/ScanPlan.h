#pragma once

#include "catalogue/Catalogue.h"

#include <host/PluginLocator.h>

#include <string>
#include <vector>

namespace zebhost
{

// What a scan is going to touch, and why. Making a plan opens no plug-in and changes nothing.
struct ScanPlan
{
    struct Item
    {
        zebaudiofilterhost::PluginLocator locator;
        // "new", "changed", "asked for", "full scan", "failed before", "was blocked", "was blocked, and has changed",
        // "was unblocked";
        // of what is dropped "gone", "blocked"; of what is skipped why it was blocked or
        // could not be loaded
        std::string why;
    };

    std::vector<Item> toScan; // one technology after the other
    std::vector<Item> toDrop; // records of the catalogue
    std::vector<Item> blocked;
    std::vector<Item> failed; // could not be loaded the last time, and is still the same
    // Records from a time when nothing was known of their binaries: those that are there now are taken to be the
    // same.
    std::vector<zebaudiofilterhost::PluginLocator> unstamped;
};

struct ScanWishes
{
    bool full = false;         // what is in the catalogue as well
    bool retryBlocked = false; // what is blocked, but not by hand, as well, and what could not be loaded
};

// Of the standard places. Records of plug-ins elsewhere stay for as long as the plug-in is there.
ScanPlan PlanStandardScan(const Catalogue& catalogue, const ScanWishes& wishes);

// Of bundles and folders. Throws a Failure if nothing is at a path, or if a bundle that was named is blocked.
ScanPlan PlanPathScan(const Catalogue& catalogue, const std::vector<std::string>& paths, const ScanWishes& wishes);

} // namespace zebhost
