#include "commands/ScanReport.h"

#include "catalogue/PluginFinder.h"
#include "filter/Interrupt.h"
#include "output/ProgressBar.h"
#include "output/Strings.h"
#include "output/TextTable.h"

#include <algorithm>
#include <set>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;
using End = IScanObserver::End;

namespace
{

constexpr const char* kFailed = "failed";
constexpr const char* kDropped = "dropped";
constexpr const char* kBlocked = "blocked";
constexpr const char* kScanned = "scanned";

const char* StateOf(End end)
{
    switch (end)
    {
    case End::Scanned:
        return kScanned;
    case End::Failed:
        return kFailed;
    case End::Crashed:
        return "crashed";
    case End::TimedOut:
        return "timed-out";
    case End::Interrupted:
        break;
    }
    return "interrupted";
}

std::optional<Failure> FailureOf(const std::string& path, const IScanObserver::Outcome& outcome)
{
    switch (outcome.end)
    {
    case End::Scanned:
        return std::nullopt;
    case End::Failed:
        return Failure(ExitCode::NotLoaded, outcome.problem);
    case End::Crashed:
    case End::TimedOut:
        return Failure(ExitCode::Crashed, path + " " + outcome.problem +
                                              ": it is blocked now; 'zebhost scan "
                                              "--retry-blocked' gives it another chance");
    case End::Interrupted:
        break;
    }
    return Failure(ExitCode::JobFailed, path + " " + outcome.problem + ": scan it again");
}

std::string Part(std::size_t count, const std::string& what)
{
    return count == 0 ? std::string() : ", " + std::to_string(count) + " " + what;
}

} // namespace

ScanReport::ScanReport(const CommandContext& context, const ScanPlan& plan) : mContext(context), mPlan(plan)
{
}

void ScanReport::Stepping(const PluginLocator& locator, const std::string& detail, std::size_t current,
                          std::size_t total)
{
    const bool isFile = PlaceOf(locator) == PathOf(locator);
    const std::string plugin = isFile ? std::filesystem::path(PathOf(locator)).stem().string() : PlaceOf(locator);
    const std::string name = plugin + (detail.empty() ? "" : " ") + detail;
    if (mContext.console.IsErrorTerminal())
    {
        mContext.console.ShowProgress(
            ProgressBar(static_cast<long long>(current), static_cast<long long>(total), name));
    }
    else
    {
        mContext.console.Remark(std::to_string(current) + "/" + std::to_string(total) + " " + name);
    }
}

void ScanReport::Finished(const PluginLocator& locator, const Outcome& outcome)
{
    const std::string path = PathOf(locator);
    mResults.push_back({path, PlaceOf(locator), StateOf(outcome.end), outcome.problem, outcome.effects,
                        zebhost::FailureOf(path, outcome)});
    ++mFinished;
    if (outcome.end == End::Crashed || outcome.end == End::TimedOut)
    {
        mContext.console.Remark("zebhost: " + PlaceOf(locator) + " " + outcome.problem + "; it is blocked now");
    }
}

bool ScanReport::ShallStop() const
{
    return interrupt::IsRequested();
}

std::optional<Failure> ScanReport::FailureOf(const std::vector<std::string>& paths) const
{
    std::set<std::string> named;
    for (const std::string& path : paths)
    {
        for (const PluginLocator& locator : PluginsAt(path))
        {
            named.insert(PathOf(locator));
        }
    }
    const auto isNamed = [&named](const Result& result)
    {
        return named.contains(result.path);
    };
    const auto found =
        std::find_if(mResults.begin(), mResults.end(),
                     [&isNamed](const Result& result) { return result.failure.has_value() && isNamed(result); });
    return found == mResults.end() ? std::nullopt : found->failure;
}

void ScanReport::Add(const std::vector<ScanPlan::Item>& items, const char* state)
{
    for (const ScanPlan::Item& item : items)
    {
        mResults.push_back({PathOf(item.locator), PlaceOf(item.locator), state, item.why, 0, std::nullopt});
    }
}

std::size_t ScanReport::Count(const char* state) const
{
    return static_cast<std::size_t>(std::count_if(mResults.begin(), mResults.end(),
                                                  [state](const Result& result) { return result.state == state; }));
}

void ScanReport::Print(const std::optional<Failure>& trouble, std::size_t restarts)
{
    Add(mPlan.toDrop, kDropped);
    Add(mPlan.failed, kFailed);
    Add(mPlan.blocked, kBlocked);
    Json document = trouble ? FailureDocument(mContext.arguments.command, *trouble) : mContext.NewDocument();
    document["restarts"] = restarts;
    Print(std::move(document));
}

void ScanReport::PrintPlan()
{
    Add(mPlan.toDrop, "would-drop");
    Add(mPlan.toScan, "would-scan");
    Add(mPlan.failed, kFailed);
    Add(mPlan.blocked, kBlocked);
    Print(mContext.NewDocument());
}

void ScanReport::Print(Json document) const
{
    TextTable table({"STATE", "PATH", "RESULT"});
    document["plugins"] = Json::array();
    for (const Result& result : mResults)
    {
        const std::string effects = result.effects == 0 ? "no effect in it" : Counted(result.effects, "effect");
        table.AddRow({result.state, result.place, result.state == kScanned ? effects : result.detail});
        document["plugins"].push_back(Json{
            {"path", result.path}, {"state", result.state}, {"effects", result.effects}, {"reason", result.detail}});
    }
    if (mContext.WantsJson())
    {
        mContext.Print(document);
    }
    else if (!table.IsEmpty())
    {
        mContext.console.Print(table.Text(mContext.console.HasOutputColour()));
    }
}

std::string ScanReport::Summary() const
{
    std::size_t effects = 0;
    for (const Result& result : mResults)
    {
        effects += result.effects;
    }
    const std::string rest = Part(Count(kFailed), "could not be loaded") + Part(Count("crashed"), "crashed") +
                             Part(Count("timed-out"), "did not answer") + Part(Count("interrupted"), "interrupted") +
                             Part(mPlan.toDrop.size(), "dropped") + Part(mPlan.blocked.size(), "blocked before");
    const std::string hint = Count("crashed") + Count("timed-out") + mPlan.blocked.size() == 0
                                 ? std::string()
                                 : "; 'zebhost blocks' tells why";
    if (mPlan.toScan.empty())
    {
        return "zebhost: nothing to scan" + rest + (mPlan.blocked.empty() ? WhatElse() : hint);
    }
    return "zebhost: " + Counted(mFinished, "plug-in") + " scanned, " + Counted(effects, "effect") + " found" + rest +
           hint;
}

std::string ScanReport::WhatElse() const
{
    const std::vector<std::string> paths = mContext.arguments.All("PATH");
    return paths.empty() ? "; --full scans again what is in the catalogue"
                         : " in " + Joined(paths, ", ") + ": a plug-in's name ends in " + kPluginNameEnds;
}

std::string ScanReport::PlanSummary() const
{
    return "zebhost: " + Counted(mPlan.toScan.size(), "plug-in") + " would be scanned, " +
           std::to_string(mPlan.toDrop.size()) + " dropped" +
           Part(mPlan.failed.size(), "could not be loaded before") + Part(mPlan.blocked.size(), "blocked") +
           "; nothing was done";
}

} // namespace zebhost
