#include "catalogue/ScanSession.h"

#include "catalogue/LoadProblem.h"
#include "catalogue/PluginFinder.h"
#include "filter/CrashGuard.h"
#include "output/PrintableText.h"

#include <foundation/zebcore/MainThreadLoop.h>
#include <host/AudioFilterDescriptor.h>
#include <host/AudioFilterDescriptorManager.h>
#include <host/PluginModuleInfo.h>
#include <host/PluginModuleInfoManager.h>
#include <host/PluginModuleScanner.h>

#include <algorithm>
#include <exception>
#include <map>

namespace zebhost
{

using zebaudiofilterhost::AudioFilterDescriptorManager;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;
using zebaudiofilterhost::PluginModuleScanner;
using zebaudiofilterhost::TechnologyType;

namespace
{

constexpr const char* kAtHand = "at hand in a scan that did not end";

IScanObserver::Outcome OutcomeOf(const PluginLocator& locator, const std::string& thrown)
{
    IScanObserver::Outcome outcome;
    outcome.loaded = PluginModuleInfoManager::GetInstance().FindPluginInfo(locator) != nullptr;
    const auto descriptors = AudioFilterDescriptorManager::GetInstance().GetExternalInfos();
    outcome.effects = static_cast<std::size_t>(std::count_if(descriptors.begin(), descriptors.end(),
                                                             [&locator](const auto& descriptor)
                                                             { return descriptor->GetLocator() == locator; }));
    if (!outcome.loaded)
    {
        outcome.problem = thrown.empty() ? LoadProblem(locator) : thrown;
    }
    return outcome;
}

} // namespace

ScanSession::ScanSession(Catalogue* catalogue, IScanObserver& observer, const Options& options)
    : mCatalogue(catalogue), mObserver(observer), mOptions(options)
{
}

void ScanSession::Run(const std::vector<PluginLocator>& locators)
{
    mDone = 0;
    mTotal = locators.size();
    // A scanner's step that ends one technology goes on into the next, whose plug-in nobody has announced.
    std::map<TechnologyType, std::vector<PluginLocator>> byTechnology;
    for (const PluginLocator& locator : locators)
    {
        byTechnology[locator.GetTechnologyType()].push_back(locator);
    }
    for (const auto& [type, share] : byTechnology)
    {
        RunTechnology(share);
    }
}

void ScanSession::RunTechnology(const std::vector<PluginLocator>& locators)
{
    for (const PluginLocator& locator : locators)
    {
        if (mObserver.ShallStop())
        {
            return;
        }
        const bool wasKnown = Announce(locator);
        Conclude(locator, wasKnown, ScanGuarded(locator));
        ++mDone;
    }
}

bool ScanSession::Announce(const PluginLocator& locator)
{
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    const bool wasKnown = infos.FindPluginInfo(locator) != nullptr;
    // A new descriptor does not displace an old one of the same ID.
    infos.RemovePluginLocators({locator});
    if (mCatalogue != nullptr)
    {
        mCatalogue->Block(locator, kAtHand);
    }
    return wasKnown;
}

// What a plug-in throws ends its own scan, and no other's.
std::string ScanSession::ScanGuarded(const PluginLocator& locator)
{
    const std::string what = PathOf(locator) + " could not be scanned: it threw an exception";
    try
    {
        ScanOne(locator);
        return {};
    }
    catch (const std::exception& error)
    {
        return what + ", \"" + error.what() + "\"";
    }
    catch (...)
    {
        return what;
    }
}

void ScanSession::ScanOne(const PluginLocator& locator)
{
    const CrashGuard guard(PathOf(locator),
                           mCatalogue != nullptr
                               ? "it is blocked now; run the scan again, which goes on with the others"
                               : "do not use it, or keep it from being used with 'zebhost block'",
                           mOptions.timeoutSeconds);
    PluginModuleScanner scanner({locator}, mOptions.skipCategory);
    scanner.BeginScan();
    PluginLocator announced;
    zebcore::UTF16String detail;
    int current = 0;
    int total = 0;
    while (scanner.GetCurrentProgressInfo(announced, detail, current, total))
    {
        guard.NoteProgress();
        mObserver.Stepping(locator, Printable(detail), mDone + 1, mTotal);
        scanner.ContinueScan();
        zebcore::threads::PumpMainThread();
    }
    scanner.EndScan();
}

void ScanSession::Conclude(const PluginLocator& locator, bool wasKnown, const std::string& thrown)
{
    const IScanObserver::Outcome outcome = OutcomeOf(locator, thrown);
    if (mCatalogue != nullptr)
    {
        if (outcome.loaded || wasKnown)
        {
            mCatalogue->Save();
        }
        mCatalogue->Unblock(locator);
    }
    mObserver.Finished(locator, outcome);
}

} // namespace zebhost
