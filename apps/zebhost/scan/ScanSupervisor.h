#pragma once

#include "catalogue/IScanObserver.h"
#include "scan/ScanJournal.h"
#include "scan/ScanWorker.h"
#include "scan/ScanWorkerProcess.h"
#include "scan/WorkerOutput.h"

#include <memory>
#include <vector>

namespace zebhost
{

// Scans plug-ins in worker processes and keeps the books: the only process that touches the settings is this one,
// which touches no plug-in. A plug-in that ends its worker, or makes no progress, stays blocked with the reason, and
// the scan goes on in a new worker. [main]
class ScanSupervisor
{
public:
    struct Options
    {
        bool skipCategory = false;
        double timeoutSeconds = 0; // 0 waits for ever
        bool showOutput = false;   // what plug-ins print goes on to standard error
        std::vector<std::string> traces;
    };

    ScanSupervisor(Catalogue& catalogue, Console& console, IScanObserver& observer, Options options);
    ~ScanSupervisor();
    ScanSupervisor(const ScanSupervisor&) = delete;
    ScanSupervisor& operator=(const ScanSupervisor&) = delete;

    // Throws a Failure when a file can't be written, or no worker be started; what is done by then is saved. So it
    // does at the end if no worker turned to one of the plug-ins.
    void Run(const std::vector<zebaudiofilterhost::PluginLocator>& locators);
    // How many workers were lost.
    std::size_t Restarts() const { return mRestarts; }

private:
    enum class Verdict
    {
        Result,
        Stopped,   // by the observer
        Untouched, // the worker was lost before it turned to the plug-in
        Lost,
        TimedOut
    };
    struct Progress
    {
        std::size_t current;
        std::size_t total;
    };

    // False when the scan is to end.
    bool ScanOne(const zebaudiofilterhost::PluginLocator& locator, const Progress& progress);
    Verdict TryOrRelease(const zebaudiofilterhost::PluginLocator& locator, const Progress& progress);
    Verdict Try(const zebaudiofilterhost::PluginLocator& locator, const Progress& progress);
    Verdict Await(const zebaudiofilterhost::PluginLocator& locator, const Progress& progress);
    void UseWorkerFor(zebaudiofilterhost::TechnologyType type);
    void StartWorker();
    void TakeResult(const zebaudiofilterhost::PluginLocator& locator);
    void Blame(const zebaudiofilterhost::PluginLocator& locator, Verdict verdict);

    Catalogue& mCatalogue;
    IScanObserver& mObserver;
    Options mOptions;
    ScanJournal mJournal;
    WorkerOutput mOutput;
    std::unique_ptr<ScanWorkerProcess> mWorker;
    zebaudiofilterhost::TechnologyType mTechnology = zebaudiofilterhost::kTechnologyNone; // that the worker has seen
    protocol::Message mResult;
    std::size_t mRestarts = 0;
    std::vector<std::string> mUntouched; // paths
};

} // namespace zebhost
