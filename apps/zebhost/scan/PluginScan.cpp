#include "scan/PluginScan.h"

#include "catalogue/LoadProblem.h"
#include "catalogue/PluginFinder.h"
#include "output/PrintableText.h"

#include <foundation/zebcore/MainThreadLoop.h>
#include <host/AudioFilterDescriptor.h>
#include <host/AudioFilterDescriptorManager.h>
#include <host/PluginModuleInfo.h>
#include <host/PluginModuleInfoManager.h>
#include <host/PluginModuleScanner.h>

#include <algorithm>
#include <exception>

namespace zebhost
{

using zebaudiofilterhost::AudioFilterDescriptorManager;
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
    const std::string what = PathOf(locator) + " could not be scanned: it threw an exception";
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
    infos.RemovePluginLocators({locator});
    const std::string thrown = StepGuarded(locator, skipCategory, beforeStep);

    IScanObserver::Outcome outcome;
    outcome.loaded = infos.FindPluginInfo(locator) != nullptr;
    const auto descriptors = AudioFilterDescriptorManager::GetInstance().GetExternalInfos();
    outcome.effects = static_cast<std::size_t>(std::count_if(descriptors.begin(), descriptors.end(),
                                                             [&locator](const auto& descriptor)
                                                             { return descriptor->GetLocator() == locator; }));
    if (!outcome.loaded)
    {
        outcome.problem = thrown.empty() ? LoadProblem(locator) : thrown;
        outcome.end = IScanObserver::End::Failed;
    }
    return outcome;
}

} // namespace zebhost
