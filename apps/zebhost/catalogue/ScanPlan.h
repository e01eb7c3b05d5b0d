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
        std::string why; // "new", "asked for", "full scan", "gone", "blocked"
    };

    std::vector<Item> toScan;
    std::vector<Item> toDrop;  // records of the catalogue
    std::vector<Item> skipped; // found, and blocked
};

// Of the standard places. Records of plug-ins elsewhere stay for as long as the plug-in is there.
ScanPlan PlanStandardScan(const Catalogue& catalogue, bool full);

// Of bundles and folders. Throws a Failure if nothing is at a path, or if a bundle that was named is blocked.
ScanPlan PlanPathScan(const Catalogue& catalogue, const std::vector<std::string>& paths);

} // namespace zebhost
