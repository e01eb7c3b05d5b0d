#pragma once

#include "catalogue/Catalogue.h"
#include "catalogue/IScanObserver.h"
#include "scan/ScanJournal.h"

#include <optional>
#include <vector>

namespace zebhost
{

// Scans plug-ins in this process. A crash ends it, with a sentence that names the plug-in. [main]
class ScanSession
{
public:
    struct Options
    {
        bool skipCategory = false;
        unsigned int timeoutSeconds = 0; // 0 waits for ever
    };

    // A null catalogue scans into memory only: nothing is saved, nothing blocked.
    ScanSession(Catalogue* catalogue, IScanObserver& observer, const Options& options);

    void Run(const std::vector<zebaudiofilterhost::PluginLocator>& locators);

private:
    void ScanOne(const zebaudiofilterhost::PluginLocator& locator, std::size_t current, std::size_t total);

    IScanObserver& mObserver;
    Options mOptions;
    std::optional<ScanJournal> mJournal;
};

} // namespace zebhost
