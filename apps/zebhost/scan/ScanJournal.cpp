#include "scan/ScanJournal.h"

#include "cli/Failure.h"

#include <host/BannedPluginManager.h>
#include <host/PluginModuleInfoManager.h>

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
    mCatalogue.Block(locator, {kAtHand, TimeOfNow(), mBinary, true, mWasKnown}, LocatorTable::Saving::Quick);
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
    mCatalogue.Stamps().Set(locator, {mBinary, problem});
    mCatalogue.SaveStamps(LocatorTable::Saving::Quick);
}

void ScanJournal::Condemn(const PluginLocator& locator, const std::string& reason)
{
    mCatalogue.Block(locator, {reason, TimeOfNow(), mBinary, false, false});
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
