#include "catalogue/ScanPlan.h"

#include "catalogue/PluginFinder.h"
#include "cli/Failure.h"

#include <host/BannedPluginManager.h>
#include <host/PluginModuleInfoManager.h>

#include <iterator>

namespace zebhost
{

using zebaudiofilterhost::BannedPluginManager;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;

namespace
{

void PlanRemoval(ScanPlan& plan, const std::vector<PluginLocator>& removed)
{
    const BannedPluginManager& blocks = BannedPluginManager::GetInstance();
    for (const PluginLocator& locator : removed)
    {
        std::error_code error;
        if (blocks.IsPluginBanned(locator))
        {
            plan.toDrop.push_back({locator, "blocked"});
        }
        else if (!std::filesystem::exists(PathOf(locator), error))
        {
            plan.toDrop.push_back({locator, "gone"});
        }
    }
}

void PlanBundle(ScanPlan& plan, const Catalogue& catalogue, const PluginLocator& locator)
{
    if (catalogue.IsBlocked(locator))
    {
        plan.skipped.push_back({locator, "blocked"});
    }
    else
    {
        plan.toScan.push_back({locator, "asked for"});
    }
}

} // namespace

ScanPlan PlanStandardScan(const Catalogue& catalogue, bool full)
{
    const PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    ScanPlan plan;
    std::vector<PluginLocator> removed;
    // All that is there, since a link to a plug-in that is in the catalogue already would look new.
    for (const PluginLocator& locator : WithoutDoubles(infos.CollectPotentialPlugins(false, removed)))
    {
        if (catalogue.IsBlocked(locator))
        {
            plan.skipped.push_back({locator, "blocked"});
            continue;
        }
        const bool known = infos.FindPluginInfo(locator) != nullptr;
        if (full || !known)
        {
            plan.toScan.push_back({locator, known ? "full scan" : "new"});
        }
    }
    PlanRemoval(plan, removed);
    return plan;
}

ScanPlan PlanPathScan(const Catalogue& catalogue, const std::vector<std::string>& paths)
{
    std::vector<PluginLocator> found;
    for (const std::string& path : paths)
    {
        const std::vector<PluginLocator> below = FindPlugins(path);
        if (IsBundlePath(path) && catalogue.IsBlocked(below.front()))
        {
            throw Failure(ExitCode::Blocked, catalogue.BlockedBecause(below.front()));
        }
        std::copy(below.begin(), below.end(), std::back_inserter(found));
    }
    ScanPlan plan;
    for (const PluginLocator& locator : WithoutDoubles(found))
    {
        PlanBundle(plan, catalogue, locator);
    }
    return plan;
}

} // namespace zebhost
