#include "scan/ScanJournal.h"

#include "catalogue/PluginKnowledge.h"
#include "cli/Failure.h"

#include <host/PluginModuleInfoManager.h>

#include <optional>

#include <unistd.h>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;

namespace
{

constexpr const char* kAtHand = "at hand in a scan that did not end";

// What a power failure may cost, and a program that reads the files themselves may be behind.
constexpr std::chrono::seconds kSaveEvery{2};

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

ScanJournal::ScanJournal(Catalogue& catalogue) : mCatalogue(catalogue), mLastSave(std::chrono::steady_clock::now())
{
}

void ScanJournal::Announce(const PluginLocator& locator)
{
    mBinary = StampOf(locator);
    mVisit = NewVisit();
    ScanFact fact;
    fact.plugin = locator;
    fact.block = BlockReason{kAtHand, TimeOfNow(), mBinary, true, IsKnown(locator), mVisit, false};
    mAnnouncement = mCatalogue.Announce(fact);
}

void ScanJournal::Conclude(const PluginLocator& locator, const std::string& problem)
{
    ScanFact fact;
    fact.plugin = locator;
    fact.result = ResultOf(locator, problem);
    // What could not be loaded keeps the record of an earlier scan.
    fact.found = problem.empty() ? PluginKnowledge(locator).Text() : zebcore::UTF8String();
    Note(fact);
}

void ScanJournal::Condemn(const PluginLocator& locator, const std::string& reason)
{
    ScanFact fact;
    fact.plugin = locator;
    fact.block = BlockReason{reason, TimeOfNow(), mBinary, false, false, {}, false};
    // What an earlier scan made of it is worth nothing any more.
    fact.isForgotten = true;
    Note(fact);
}

void ScanJournal::Note(const ScanFact& fact)
{
    try
    {
        mCatalogue.Note(fact);
    }
    catch (const Failure&)
    {
        if (!fact.block)
        {
            ReleaseAfterFailure();
        }
        throw;
    }
    if (std::chrono::steady_clock::now() - mLastSave > kSaveEvery)
    {
        Finish();
    }
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

void ScanJournal::Release()
{
    mCatalogue.TakeBack(mAnnouncement);
}

void ScanJournal::ReleaseAfterFailure()
{
    try
    {
        Release();
    }
    catch (const Failure&)
    {
        // The first failure says why; the files that this one needs may lie on the same disk.
    }
}

void ScanJournal::Finish()
{
    mCatalogue.SaveNoted();
    mLastSave = std::chrono::steady_clock::now();
}

} // namespace zebhost
