#include "scan/ScanJournal.h"

#include "cli/Failure.h"

#include <host/BannedPluginManager.h>
#include <host/PluginModuleInfoManager.h>

#include <chrono>

#include <unistd.h>

namespace zebhost
{

using zebaudiofilterhost::BannedPluginManager;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;

namespace
{

constexpr const char* kAtHand = "at hand in a scan that did not end";

bool IsKnown(const PluginLocator& locator)
{
    return PluginModuleInfoManager::GetInstance().FindPluginInfo(locator) != nullptr;
}

// No two are the same.
std::string NewVisit()
{
    static unsigned int sCount = 0;
    return std::to_string(std::chrono::system_clock::now().time_since_epoch().count()) + "-" +
           std::to_string(getpid()) + "-" + std::to_string(++sCount);
}

} // namespace

ScanJournal::ScanJournal(Catalogue& catalogue) : mCatalogue(catalogue)
{
}

void ScanJournal::Announce(const PluginLocator& locator)
{
    mWasKnown = IsKnown(locator);
    mBinary = StampOf(locator);
    mBlockedBefore.reset();
    if (BannedPluginManager::GetInstance().IsPluginBanned(locator))
    {
        mBlockedBefore = mCatalogue.Reasons().Get(locator);
    }
    mVisit = NewVisit();
    try
    {
        mCatalogue.Block(locator, {kAtHand, TimeOfNow(), mBinary, true, mWasKnown, mVisit, false},
                         LocatorTable::Saving::Quick);
    }
    catch (const Failure&)
    {
        // The new list may be in place, and only the folder not flushed.
        ReleaseAfterFailure(locator);
        throw;
    }
}

void ScanJournal::Conclude(const PluginLocator& locator, const std::string& problem)
{
    try
    {
        Record(locator, problem);
    }
    catch (const Failure&)
    {
        ReleaseAfterFailure(locator);
        throw;
    }
    mCatalogue.Unblock(locator);
}

void ScanJournal::Record(const PluginLocator& locator, const std::string& problem)
{
    if (mWasKnown || IsKnown(locator))
    {
        mCatalogue.Save();
    }
    mCatalogue.Stamps().Set(locator, ResultOf(locator, problem));
    mCatalogue.SaveStamps(LocatorTable::Saving::Quick);
}

// A plug-in that is in the catalogue, and cannot be loaded, keeps its record and the stamp that belongs to it:
// another binary counts as changed for as long as it fails.
BinaryStamps::Entry ScanJournal::ResultOf(const PluginLocator& locator, const std::string& problem) const
{
    if (problem.empty() || !IsKnown(locator))
    {
        return {mBinary, problem, mVisit};
    }
    const std::optional<BinaryStamps::Entry> last = mCatalogue.Stamps().Find(locator);
    return {last ? last->binary : BinaryStamp(), {}, mVisit};
}

void ScanJournal::Condemn(const PluginLocator& locator, const std::string& reason)
{
    mCatalogue.Block(locator, {reason, TimeOfNow(), mBinary, false, false, {}, false});
    // What an earlier scan made of it is worth nothing any more.
    mCatalogue.Stamps().Remove(locator);
    mCatalogue.SaveStamps(LocatorTable::Saving::Quick);
    if (mWasKnown)
    {
        PluginModuleInfoManager::GetInstance().RemovePluginLocators({locator});
        mCatalogue.Save();
    }
}

void ScanJournal::Release(const PluginLocator& locator)
{
    if (mBlockedBefore)
    {
        mCatalogue.Block(locator, *mBlockedBefore);
    }
    else
    {
        mCatalogue.Unblock(locator);
    }
}

void ScanJournal::ReleaseAfterFailure(const PluginLocator& locator)
{
    try
    {
        Release(locator);
    }
    catch (const Failure&)
    {
        // The first failure says why; the files that this one needs may lie on the same disk.
    }
}

} // namespace zebhost
