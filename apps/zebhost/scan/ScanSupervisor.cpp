#include "scan/ScanSupervisor.h"

#include "catalogue/PluginFinder.h"
#include "cli/Failure.h"
#include "output/Numbers.h"
#include "scan/StallClock.h"

#include <host/PluginModuleInfoManager.h>

#include <unistd.h>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;
using zebaudiofilterhost::TechnologyType;
using Kind = protocol::Message::Kind;

ScanSupervisor::ScanSupervisor(Catalogue& catalogue, Console& console, IScanObserver& observer, Options options)
    : mCatalogue(catalogue)
    , mObserver(observer)
    , mOptions(std::move(options))
    , mJournal(catalogue)
    , mOutput(console, mOptions.showOutput)
{
}

ScanSupervisor::~ScanSupervisor() = default;

void ScanSupervisor::Run(const std::vector<PluginLocator>& locators)
{
    for (std::size_t index = 0; index < locators.size(); ++index)
    {
        if (mObserver.ShallStop() || !ScanOne(locators[index], {index + 1, locators.size()}))
        {
            break;
        }
    }
    mWorker.reset();
    mJournal.Finish();
    if (!mUntouched.empty())
    {
        throw Failure(ExitCode::JobFailed, "the scan's worker processes ended before they turned to " +
                                               mUntouched.front() +
                                               ": scan it with --in-process, and tell what happens");
    }
}

bool ScanSupervisor::ScanOne(const PluginLocator& locator, const Progress& progress)
{
    UseWorkerFor(locator.GetTechnologyType());
    mOutput.Begin();
    mJournal.Announce(locator);
    const Verdict verdict = TryOrRelease(locator, progress);
    switch (verdict)
    {
    case Verdict::Result:
        TakeResult(locator);
        return true;
    case Verdict::Stopped:
        mWorker.reset();
        mJournal.Release();
        return false;
    case Verdict::Untouched:
        mWorker.reset();
        mJournal.Release();
        mUntouched.push_back(PathOf(locator));
        return true;
    case Verdict::Lost:
    case Verdict::TimedOut:
        break;
    }
    Blame(locator, verdict);
    return true;
}

// A worker that cannot be started again says nothing against the plug-in at hand.
ScanSupervisor::Verdict ScanSupervisor::TryOrRelease(const PluginLocator& locator, const Progress& progress)
{
    try
    {
        return Try(locator, progress);
    }
    catch (...)
    {
        mWorker.reset();
        mJournal.ReleaseAfterFailure();
        throw;
    }
}

// Something that a plug-in before left running may end a worker at any time; the next plug-in is not to blame.
ScanSupervisor::Verdict ScanSupervisor::Try(const PluginLocator& locator, const Progress& progress)
{
    constexpr int kTries = 3;
    for (int count = 0;; ++count)
    {
        mWorker->Send(protocol::ScanLine(locator));
        const Verdict verdict = Await(locator, progress);
        if (verdict != Verdict::Untouched || count == kTries)
        {
            return verdict;
        }
        ++mRestarts;
        StartWorker();
    }
}

ScanSupervisor::Verdict ScanSupervisor::Await(const PluginLocator& locator, const Progress& progress)
{
    StallClock clock(mOptions.timeoutSeconds);
    bool isTouched = false;
    std::string line;
    while (!mObserver.ShallStop())
    {
        const ScanWorkerProcess::Event event = mWorker->Wait(line);
        clock.Tick();
        if (event == ScanWorkerProcess::Event::Silence)
        {
            if (clock.HasExpired())
            {
                return isTouched ? Verdict::TimedOut : Verdict::Untouched;
            }
            continue;
        }
        const bool hasEnded = event == ScanWorkerProcess::Event::Ended;
        mResult = hasEnded ? protocol::Message() : protocol::ParseMessage(line);
        if (mResult.kind == Kind::Result)
        {
            return Verdict::Result;
        }
        if (mResult.kind != Kind::Step)
        {
            return isTouched ? Verdict::Lost : Verdict::Untouched;
        }
        isTouched = true;
        clock.Restart();
        mObserver.Stepping(locator, mResult.detail, progress.current, progress.total);
    }
    return Verdict::Stopped;
}

// The step that ends one technology goes on into the next; so each has workers of its own.
void ScanSupervisor::UseWorkerFor(TechnologyType type)
{
    if (!mWorker || type != mTechnology)
    {
        StartWorker();
        mTechnology = type;
    }
}

void ScanSupervisor::StartWorker()
{
    constexpr double kStartSeconds = 60;
    mWorker.reset();
    const WorkerSetup setup{mCatalogue.Folder().Path().string(), mOptions.skipCategory, mOptions.traces};
    mWorker = std::make_unique<ScanWorkerProcess>(WorkerCommandLine(setup, getpid()), mOutput);
    StallClock clock(kStartSeconds);
    std::string line;
    ScanWorkerProcess::Event event = ScanWorkerProcess::Event::Silence;
    while (event == ScanWorkerProcess::Event::Silence && !clock.HasExpired() && !mObserver.ShallStop())
    {
        event = mWorker->Wait(line);
        clock.Tick();
    }
    if (!mObserver.ShallStop() &&
        (event != ScanWorkerProcess::Event::Line || protocol::ParseMessage(line).kind != Kind::Ready))
    {
        const std::string printed = mOutput.LastLine();
        throw Failure(ExitCode::JobFailed, "the scan's worker process does not start" +
                                               (printed.empty() ? "" : ": \"" + printed + "\"") +
                                               "; scan with --in-process, and tell what happens");
    }
}

void ScanSupervisor::TakeResult(const PluginLocator& locator)
{
    // What could not be loaded keeps the record of an earlier scan.
    if (mResult.outcome.loaded)
    {
        PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
        infos.RemovePluginLocators({locator});
        infos.AddConfiguration(mResult.found, true);
    }
    mJournal.Conclude(locator, mResult.outcome.problem);
    mObserver.Finished(locator, mResult.outcome);
}

void ScanSupervisor::Blame(const PluginLocator& locator, Verdict verdict)
{
    IScanObserver::Outcome outcome;
    const WorkerEnd end = mWorker->End();
    mWorker.reset();
    if (verdict == Verdict::TimedOut)
    {
        outcome.end = IScanObserver::End::TimedOut;
        outcome.problem = "did not answer for " + ShortNumber(mOptions.timeoutSeconds) +
                          (mOptions.timeoutSeconds == 1 ? " second" : " seconds");
    }
    else
    {
        outcome.end = end.IsByUser() ? IScanObserver::End::Interrupted : IScanObserver::End::Crashed;
        outcome.problem = end.Describe();
    }
    const std::string printed = mOutput.LastLine();
    outcome.problem += printed.empty() ? "" : "; it printed: " + printed;
    if (outcome.end == IScanObserver::End::Interrupted)
    {
        mJournal.Release();
    }
    else
    {
        ++mRestarts;
        mJournal.Condemn(locator, outcome.problem);
    }
    mObserver.Finished(locator, outcome);
}

} // namespace zebhost
