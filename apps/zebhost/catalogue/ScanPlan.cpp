#include "catalogue/ScanPlan.h"

#include "catalogue/PluginFinder.h"
#include "cli/Failure.h"

#include <host/BannedPluginManager.h>
#include <host/PluginModuleInfoManager.h>

#include <algorithm>
#include <iterator>
#include <optional>

namespace zebhost
{

using zebaudiofilterhost::BannedPluginManager;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;

namespace
{

constexpr const char* kUnblocked = "was unblocked";

// What is no file is looked up among all that is found, from which the blocked are left out.
bool IsThere(const PluginLocator& locator)
{
    return IsInstalled(locator) || (locator.GetTechnologyType() == zebaudiofilterhost::kTechnologyAudioUnit &&
                                    BannedPluginManager::GetInstance().IsPluginBanned(locator));
}

bool IsKnown(const PluginLocator& locator)
{
    return PluginModuleInfoManager::GetInstance().FindPluginInfo(locator) != nullptr;
}

// Makes a plan, plug-in by plug-in.
class Planner
{
public:
    Planner(const Catalogue& catalogue, const ScanWishes& wishes) : mCatalogue(catalogue), mWishes(wishes) {}

    // A plug-in of the standard places, or one to be tried, that is not on the dynamic list.
    void AddFound(const PluginLocator& locator)
    {
        if (mCatalogue.IsBlocked(locator))
        {
            mPlan.blocked.push_back({locator, WhyBlocked(locator)});
            return;
        }
        const std::optional<BinaryStamps::Entry> last = mCatalogue.Stamps().Find(locator);
        const bool hasChanged = last && last->binary != StampOf(locator);
        if (mCatalogue.Stamps().IsToBeTried(locator))
        {
            AddToScan(locator, kUnblocked);
        }
        else if (IsKnown(locator))
        {
            AddKnown(locator, last.has_value(), hasChanged, mWishes.full);
        }
        else if (!last || hasChanged)
        {
            AddToScan(locator, last ? "changed" : "new");
        }
        else if (mWishes.full || mWishes.retryBlocked || last->problem.empty())
        {
            AddToScan(locator, last->problem.empty() ? "new" : "failed before");
        }
        else
        {
            mPlan.failed.push_back({locator, last->problem});
        }
    }

    // A plug-in on the dynamic list, wherever it lies.
    void AddBlocked(const PluginLocator& locator)
    {
        if (!IsThere(locator))
        {
            return;
        }
        if (const char* why = WhyOffered(locator))
        {
            AddToScan(locator, why);
        }
        else if (IsKnown(locator) && !mCatalogue.Reasons().Get(locator).isAtHand)
        {
            mPlan.toDrop.push_back({locator, "blocked"});
        }
        else
        {
            mPlan.blocked.push_back({locator, WhyBlocked(locator)});
        }
    }

    // A record whose plug-in is not on the dynamic list, and not in the standard places.
    void AddElsewhere(const PluginLocator& locator)
    {
        if (!IsThere(locator))
        {
            mPlan.toDrop.push_back({locator, "gone"});
            return;
        }
        if (mCatalogue.Stamps().IsToBeTried(locator))
        {
            AddToScan(locator, kUnblocked);
            return;
        }
        const std::optional<BinaryStamps::Entry> last = mCatalogue.Stamps().Find(locator);
        AddKnown(locator, last.has_value(), last && last->binary != StampOf(locator), false);
    }

    // Null if a blocked plug-in is not to be offered again.
    const char* WhyOffered(const PluginLocator& locator) const
    {
        if (!BannedPluginManager::GetInstance().IsPluginBanned(locator))
        {
            return nullptr;
        }
        const BlockReason why = mCatalogue.Reasons().Get(locator);
        if (why.isByHand)
        {
            return nullptr;
        }
        if (!why.binary.IsEmpty() && why.binary != StampOf(locator))
        {
            return "was blocked, and has changed";
        }
        return mWishes.retryBlocked ? "was blocked" : nullptr;
    }

    // A plug-in below a path that was given.
    void AddAskedFor(const PluginLocator& locator)
    {
        if (const char* why = WhyOffered(locator))
        {
            AddToScan(locator, why);
        }
        else if (mCatalogue.IsBlocked(locator))
        {
            mPlan.blocked.push_back({locator, WhyBlocked(locator)});
        }
        else
        {
            AddToScan(locator, "asked for");
        }
    }

    ScanPlan Finish()
    {
        std::stable_sort(mPlan.toScan.begin(), mPlan.toScan.end(),
                         [](const ScanPlan::Item& one, const ScanPlan::Item& other)
                         { return one.locator.GetTechnologyType() < other.locator.GetTechnologyType(); });
        return std::move(mPlan);
    }

private:
    std::string WhyBlocked(const PluginLocator& locator) const
    {
        return BannedPluginManager::GetInstance().IsPluginBanned(locator) ? mCatalogue.Reasons().Get(locator).reason
                                                                          : "on the permanent block list";
    }

    void AddToScan(const PluginLocator& locator, const char* why) { mPlan.toScan.push_back({locator, why}); }

    void AddKnown(const PluginLocator& locator, bool isStamped, bool hasChanged, bool full)
    {
        if (full || hasChanged)
        {
            AddToScan(locator, hasChanged ? "changed" : "full scan");
        }
        else if (!isStamped)
        {
            mPlan.unstamped.push_back(locator);
        }
    }

    const Catalogue& mCatalogue;
    ScanWishes mWishes;
    ScanPlan mPlan;
};

} // namespace

ScanPlan PlanStandardScan(const Catalogue& catalogue, const ScanWishes& wishes)
{
    const BannedPluginManager& blocks = BannedPluginManager::GetInstance();
    Planner planner(catalogue, wishes);
    std::vector<PluginLocator> removed;
    // All that is there, since a link to a plug-in that is in the catalogue already would look new.
    std::vector<PluginLocator> found = PluginModuleInfoManager::GetInstance().CollectPotentialPlugins(false, removed);
    const std::vector<PluginLocator> toBeTried = catalogue.Stamps().AllToBeTried();
    std::copy_if(toBeTried.begin(), toBeTried.end(), std::back_inserter(found),
                 [&blocks](const PluginLocator& locator)
                 { return IsInstalled(locator) && !IsKnown(locator) && !blocks.IsPluginBanned(locator); });
    for (const PluginLocator& locator : WithoutDoubles(found))
    {
        planner.AddFound(locator);
    }
    std::for_each(blocks.BannedBegin(), blocks.BannedEnd(),
                  [&planner](const PluginLocator& locator) { planner.AddBlocked(locator); });
    for (const PluginLocator& locator : removed)
    {
        if (!blocks.IsPluginBanned(locator) || !IsThere(locator))
        {
            planner.AddElsewhere(locator);
        }
    }
    return planner.Finish();
}

ScanPlan PlanPathScan(const Catalogue& catalogue, const std::vector<std::string>& paths, const ScanWishes& wishes)
{
    Planner planner(catalogue, wishes);
    std::vector<PluginLocator> found;
    for (const std::string& path : paths)
    {
        const std::vector<PluginLocator> below = FindPlugins(path);
        const bool isRefused =
            std::all_of(below.begin(), below.end(),
                        [&](const PluginLocator& locator)
                        { return catalogue.IsBlocked(locator) && planner.WhyOffered(locator) == nullptr; });
        if (IsBundlePath(path) && isRefused)
        {
            throw Failure(ExitCode::Blocked, catalogue.BlockedBecause(below.front()));
        }
        std::copy(below.begin(), below.end(), std::back_inserter(found));
    }
    for (const PluginLocator& locator : WithoutDoubles(found))
    {
        planner.AddAskedFor(locator);
    }
    return planner.Finish();
}

} // namespace zebhost
