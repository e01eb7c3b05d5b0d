#include "catalogue/PluginFinder.h"
#include "catalogue/ScanPlan.h"
#include "catalogue/ScanSession.h"
#include "cli/Failure.h"
#include "commands/Commands.h"
#include "filter/Interrupt.h"
#include "output/ProgressBar.h"
#include "output/Strings.h"
#include "output/TextTable.h"

#include <host/PluginModuleInfoManager.h>

#include <algorithm>
#include <optional>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

namespace
{

struct Result
{
    std::string path;
    std::string state; // "scanned", "failed", "dropped", "blocked"; with --dry-run what would become of it
    std::string detail;
    std::size_t effects = 0;
};

// Shows progress, and keeps what became of each plug-in.
class Reporter : public IScanObserver
{
public:
    explicit Reporter(Console& console) : mConsole(console) {}

    void Stepping(const PluginLocator& locator, const std::string& detail, std::size_t current,
                  std::size_t total) override
    {
        const std::string name =
            std::filesystem::path(PathOf(locator)).stem().string() + (detail.empty() ? "" : " ") + detail;
        if (mConsole.IsErrorTerminal())
        {
            mConsole.ShowProgress(ProgressBar(static_cast<long long>(current), static_cast<long long>(total), name));
        }
        else
        {
            mConsole.Remark(std::to_string(current) + "/" + std::to_string(total) + " " + name);
        }
    }

    void Finished(const PluginLocator& locator, const Outcome& outcome) override
    {
        mResults.push_back(
            {PathOf(locator), outcome.loaded ? "scanned" : "failed", outcome.problem, outcome.effects});
        mFailures += outcome.loaded ? 0 : 1;
        mEffects += outcome.effects;
    }

    bool ShallStop() const override { return interrupt::IsRequested(); }

    std::vector<Result> mResults;
    std::size_t mFailures = 0;
    std::size_t mEffects = 0;

private:
    Console& mConsole;
};

std::string Detail(const Result& result)
{
    if (result.state != "scanned")
    {
        return result.detail;
    }
    return result.effects == 0 ? "no effect in it" : Counted(result.effects, "effect");
}

void PrintResults(const CommandContext& context, const std::vector<Result>& results,
                  const std::optional<Failure>& trouble)
{
    if (context.WantsJson())
    {
        Json document = trouble ? FailureDocument(context.arguments.command, *trouble) : context.NewDocument();
        document["plugins"] = Json::array();
        for (const Result& result : results)
        {
            document["plugins"].push_back(Json{{"path", result.path},
                                               {"state", result.state},
                                               {"effects", result.effects},
                                               {"reason", result.detail}});
        }
        context.Print(document);
        return;
    }
    TextTable table({"STATE", "PATH", "RESULT"});
    for (const Result& result : results)
    {
        table.AddRow({result.state, result.path, Detail(result)});
    }
    if (!table.IsEmpty())
    {
        context.console.Print(table.Text(context.console.HasOutputColour()));
    }
}

void AddPlanned(std::vector<Result>& results, const std::vector<ScanPlan::Item>& items, const std::string& state)
{
    for (const ScanPlan::Item& item : items)
    {
        results.push_back({PathOf(item.locator), state, item.why, 0});
    }
}

ExitCode DryRun(const CommandContext& context, const ScanPlan& plan)
{
    std::vector<Result> results;
    AddPlanned(results, plan.toDrop, "would-drop");
    AddPlanned(results, plan.toScan, "would-scan");
    AddPlanned(results, plan.skipped, "blocked");
    PrintResults(context, results, std::nullopt);
    context.console.Remark("zebhost: " + Counted(plan.toScan.size(), "plug-in") + " would be scanned, " +
                           std::to_string(plan.toDrop.size()) + " dropped; nothing was done");
    return ExitCode::Done;
}

void Drop(const CommandContext& context, const ScanPlan& plan)
{
    if (plan.toDrop.empty())
    {
        return;
    }
    std::vector<PluginLocator> locators;
    for (const ScanPlan::Item& item : plan.toDrop)
    {
        locators.push_back(item.locator);
    }
    zebaudiofilterhost::PluginModuleInfoManager::GetInstance().RemovePluginLocators(locators);
    context.catalogue.Save();
}

std::vector<PluginLocator> LocatorsOf(const ScanPlan& plan)
{
    std::vector<PluginLocator> locators;
    for (const ScanPlan::Item& item : plan.toScan)
    {
        locators.push_back(item.locator);
    }
    return locators;
}

// A bundle that was asked for by its own path has to load; of a folder, whatever does.
const Result* NamedFailure(const std::vector<std::string>& paths, const std::vector<Result>& results)
{
    const auto named = [&paths](const Result& result)
    {
        return std::any_of(paths.begin(), paths.end(),
                           [&result](const std::string& path)
                           { return IsBundlePath(path) && PathOf(BundleLocator(path)) == result.path; });
    };
    const auto found =
        std::find_if(results.begin(), results.end(),
                     [&named](const Result& result) { return result.state == "failed" && named(result); });
    return found == results.end() ? nullptr : &*found;
}

std::optional<Failure> TroubleOf(const CommandContext& context, const ScanPlan& plan, const Reporter& reporter)
{
    const std::size_t scanned = reporter.mResults.size();
    if (scanned < plan.toScan.size())
    {
        return Failure(ExitCode::JobFailed, "the scan was interrupted after " + std::to_string(scanned) + " of " +
                                                Counted(plan.toScan.size(), "plug-in") +
                                                ", which are saved: run it again to go on");
    }
    if (const Result* failed = NamedFailure(context.arguments.All("PATH"), reporter.mResults))
    {
        return Failure(ExitCode::NotLoaded, failed->detail);
    }
    return std::nullopt;
}

std::string Summary(const ScanPlan& plan, const Reporter& reporter)
{
    const auto part = [](std::size_t count, const std::string& what)
    {
        return count == 0 ? std::string() : ", " + std::to_string(count) + " " + what;
    };
    const std::string rest = part(reporter.mFailures, "could not be loaded") + part(plan.toDrop.size(), "dropped") +
                             part(plan.skipped.size(), "blocked");
    if (plan.toScan.empty())
    {
        return "zebhost: nothing to scan" + rest + "; --full scans again what is in the catalogue";
    }
    return "zebhost: " + Counted(reporter.mResults.size(), "plug-in") + " scanned, " +
           Counted(reporter.mEffects, "effect") + " found" + rest;
}

} // namespace

ExitCode RunScan(CommandContext& context)
{
    const std::vector<std::string> paths = context.arguments.All("PATH");
    const ScanPlan plan = paths.empty() ? PlanStandardScan(context.catalogue, context.arguments.Has("full"))
                                        : PlanPathScan(context.catalogue, paths);
    if (context.arguments.Has("dry-run"))
    {
        return DryRun(context, plan);
    }
    ScanSession::Options options;
    options.skipCategory = context.arguments.Has("skip-category");
    options.timeoutSeconds = static_cast<unsigned int>(context.arguments.Count("timeout", 30, 0, 86400));
    interrupt::Watch();
    Drop(context, plan);
    Reporter reporter(context.console);
    ScanSession(&context.catalogue, reporter, options).Run(LocatorsOf(plan));
    std::vector<Result> results = reporter.mResults;
    AddPlanned(results, plan.toDrop, "dropped");
    AddPlanned(results, plan.skipped, "blocked");
    const std::optional<Failure> trouble = TroubleOf(context, plan, reporter);
    PrintResults(context, results, trouble);
    if (trouble)
    {
        throw Failure(*trouble);
    }
    context.console.Remark(Summary(plan, reporter));
    return ExitCode::Done;
}

} // namespace zebhost
