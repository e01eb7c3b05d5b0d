#include "scan/PluginScan.h"

#include "catalogue/LoadProblem.h"
#include "catalogue/PluginFinder.h"
#include "catalogue/PluginKnowledge.h"
#include "output/PrintableText.h"

#include <foundation/zebcore/MainThreadLoop.h>
#include <host/PluginModuleInfo.h>
#include <host/PluginModuleInfoManager.h>
#include <host/PluginModuleScanner.h>

#include <exception>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;
using zebaudiofilterhost::PluginModuleScanner;

namespace
{

using BeforeStep = std::function<void(const std::string&)>;

// A scanner of its own for each plug-in: the step that ends one technology would go on into the next, whose plug-in
// nobody has announced.
void Step(const PluginLocator& locator, bool skipCategory, const BeforeStep& beforeStep)
{
    PluginModuleScanner scanner({locator}, skipCategory);
    scanner.BeginScan();
    PluginLocator announced;
    zebcore::UTF16String detail;
    int current = 0;
    int total = 0;
    while (scanner.GetCurrentProgressInfo(announced, detail, current, total))
    {
        beforeStep(Printable(detail));
        scanner.ContinueScan();
        zebcore::threads::PumpMainThread();
    }
    scanner.EndScan();
}

// What a plug-in throws ends its own scan, and no other's. Returns it as a sentence.
std::string StepGuarded(const PluginLocator& locator, bool skipCategory, const BeforeStep& beforeStep)
{
    const std::string what = PlaceOf(locator) + " could not be scanned: it threw an exception";
    try
    {
        Step(locator, skipCategory, beforeStep);
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

} // namespace

IScanObserver::Outcome ScanPlugin(const PluginLocator& locator, bool skipCategory, const BeforeStep& beforeStep)
{
    PluginModuleInfoManager& infos = PluginModuleInfoManager::GetInstance();
    // A new descriptor does not displace an old one of the same ID.
    const PluginKnowledge before(locator);
    infos.RemovePluginLocators({locator});
    const std::string thrown = StepGuarded(locator, skipCategory, beforeStep);

    const PluginKnowledge after(locator);
    IScanObserver::Outcome outcome;
    outcome.loaded = after.record != nullptr;
    outcome.effects = after.descriptors.size();
    if (!outcome.loaded)
    {
        outcome.problem = thrown.empty() ? LoadProblem(locator) : thrown;
        outcome.end = IScanObserver::End::Failed;
        if (before.record != nullptr)
        {
            infos.RemovePluginLocators({locator});
            before.PutBack();
        }
    }
    return outcome;
}

} // namespace zebhost
