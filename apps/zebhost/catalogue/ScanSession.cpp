#include "catalogue/ScanSession.h"

#include "catalogue/PluginFinder.h"
#include "filter/CrashGuard.h"
#include "scan/PluginScan.h"

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

namespace
{

IScanObserver::Outcome ScanUnderGuard(const PluginLocator& locator, const ScanSession::Options& options,
                                      const std::string& advice,
                                      const std::function<void(const std::string&)>& beforeStep)
{
    const CrashGuard guard(PlaceOf(locator), advice, options.timeoutSeconds);
    return ScanPlugin(locator, options.skipCategory,
                      [&guard, &beforeStep](const std::string& detail)
                      {
                          guard.NoteProgress();
                          beforeStep(detail);
                      });
}

} // namespace

ScanSession::ScanSession(Catalogue* catalogue, IScanObserver& observer, const Options& options)
    : mObserver(observer), mOptions(options)
{
    if (catalogue != nullptr)
    {
        mJournal.emplace(*catalogue);
    }
}

void ScanSession::Run(const std::vector<PluginLocator>& locators)
{
    for (std::size_t index = 0; index < locators.size() && !mObserver.ShallStop(); ++index)
    {
        ScanOne(locators[index], index + 1, locators.size());
    }
    if (mJournal)
    {
        mJournal->Finish();
    }
}

void ScanSession::ScanOne(const PluginLocator& locator, std::size_t current, std::size_t total)
{
    const auto beforeStep = [this, &locator, current, total](const std::string& detail)
    {
        mObserver.Stepping(locator, detail, current, total);
    };
    if (!mJournal)
    {
        constexpr const char* kAdvice = "do not use it, or keep it from being used with 'zebhost block'";
        mObserver.Finished(locator, ScanUnderGuard(locator, mOptions, kAdvice, beforeStep));
        return;
    }
    mJournal->Announce(locator);
    constexpr const char* kAdvice = "it is blocked now; run the scan again, which goes on with the others";
    const IScanObserver::Outcome outcome = ScanUnderGuard(locator, mOptions, kAdvice, beforeStep);
    mJournal->Conclude(locator, outcome.problem);
    mObserver.Finished(locator, outcome);
}

} // namespace zebhost
