#include "catalogue/ScanPlan.h"
#include "catalogue/ScanSession.h"
#include "cli/Failure.h"
#include "commands/Commands.h"
#include "commands/ScanReport.h"
#include "filter/Interrupt.h"
#include "output/Strings.h"
#include "scan/ScanSupervisor.h"

#include <host/PluginModuleInfoManager.h>

#include <cmath>
#include <csignal>
#include <optional>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;

namespace
{

// Handles a signal in another way while it lives.
class SignalHandling
{
public:
    SignalHandling(int signal, void (*handler)(int)) : mSignal(signal), mBefore(std::signal(signal, handler)) {}
    ~SignalHandling() { std::signal(mSignal, mBefore); }
    SignalHandling(const SignalHandling&) = delete;
    SignalHandling& operator=(const SignalHandling&) = delete;

private:
    int mSignal;
    void (*mBefore)(int);
};

std::vector<PluginLocator> LocatorsOf(const std::vector<ScanPlan::Item>& items)
{
    std::vector<PluginLocator> locators;
    for (const ScanPlan::Item& item : items)
    {
        locators.push_back(item.locator);
    }
    return locators;
}

ScanPlan MakePlan(const CommandContext& context)
{
    const std::vector<std::string> paths = context.arguments.All("PATH");
    const ScanWishes wishes{context.arguments.Has("full"), context.arguments.Has("retry-blocked")};
    return paths.empty() ? PlanStandardScan(context.catalogue, wishes)
                         : PlanPathScan(context.catalogue, paths, wishes);
}

// What needs no plug-in to be loaded.
void PutInOrder(const CommandContext& context, const ScanPlan& plan)
{
    if (!plan.toDrop.empty())
    {
        PluginModuleInfoManager::GetInstance().RemovePluginLocators(LocatorsOf(plan.toDrop));
        context.catalogue.Save();
    }
    for (const ScanPlan::Item& item : plan.toDrop)
    {
        context.catalogue.Stamps().Remove(item.locator);
    }
    for (const PluginLocator& locator : plan.unstamped)
    {
        context.catalogue.Stamps().Set(locator, {StampOf(locator), {}, {}});
    }
    if (!plan.toDrop.empty() || !plan.unstamped.empty())
    {
        context.catalogue.SaveStamps(LocatorTable::Saving::Flushed);
    }
}

// Returns how many worker processes were lost.
std::size_t ScanInWorkers(const CommandContext& context, const ScanPlan& plan, double timeout, ScanReport& report)
{
    interrupt::Watch(interrupt::Second::Ignored);
    // A reader of standard error that goes away must not end a scan between two saves, nor a worker's end do so.
    const SignalHandling pipesMayBreak(SIGPIPE, SIG_IGN);
    // Programs inherit that it is ignored; then nobody could be told how a worker ended.
    const SignalHandling endsAreTold(SIGCHLD, SIG_DFL);
    ScanSupervisor::Options options;
    options.skipCategory = context.arguments.Has("skip-category");
    options.timeoutSeconds = timeout;
    options.traces = context.arguments.All("trace");
    options.showOutput = context.arguments.Has("verbose") || !options.traces.empty();
    ScanSupervisor supervisor(context.catalogue, context.console, report, options);
    supervisor.Run(LocatorsOf(plan.toScan));
    return supervisor.Restarts();
}

void ScanHere(const CommandContext& context, const ScanPlan& plan, double timeout, ScanReport& report)
{
    interrupt::Watch();
    ScanSession::Options options;
    options.skipCategory = context.arguments.Has("skip-category");
    options.timeoutSeconds = static_cast<unsigned int>(std::ceil(timeout));
    ScanSession(&context.catalogue, report, options).Run(LocatorsOf(plan.toScan));
}

std::optional<Failure> TroubleOf(const CommandContext& context, const ScanPlan& plan, const ScanReport& report)
{
    if (report.CountFinished() < plan.toScan.size())
    {
        return Failure(ExitCode::JobFailed,
                       "the scan was interrupted after " + std::to_string(report.CountFinished()) + " of " +
                           Counted(plan.toScan.size(), "plug-in") + ", which are saved: run it again to go on");
    }
    return report.FailureOf(context.arguments.All("PATH"));
}

ExitCode DryRun(const CommandContext& context)
{
    const ScanPlan plan = MakePlan(context);
    ScanReport report(context, plan);
    report.PrintPlan();
    context.console.Remark(report.PlanSummary());
    return ExitCode::Done;
}

} // namespace

ExitCode RunScan(CommandContext& context)
{
    constexpr double kLongestTimeout = 86400;
    const double timeout = context.arguments.Number("timeout", 30, 0, kLongestTimeout);
    if (context.arguments.Has("dry-run"))
    {
        return DryRun(context);
    }
    const ScanPlan plan = MakePlan(context);
    ScanReport report(context, plan);
    std::size_t restarts = 0;
    std::optional<Failure> trouble;
    try
    {
        PutInOrder(context, plan);
        if (context.arguments.Has("in-process"))
        {
            ScanHere(context, plan, timeout, report);
        }
        else if (!plan.toScan.empty())
        {
            restarts = ScanInWorkers(context, plan, timeout, report);
        }
        trouble = TroubleOf(context, plan, report);
    }
    catch (const Failure& failure)
    {
        trouble = failure;
    }
    report.Print(trouble, restarts);
    if (trouble)
    {
        throw Failure(*trouble);
    }
    context.console.Remark(report.Summary());
    return ExitCode::Done;
}

} // namespace zebhost
