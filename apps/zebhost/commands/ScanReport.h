#pragma once

#include "catalogue/IScanObserver.h"
#include "catalogue/ScanPlan.h"
#include "cli/Failure.h"
#include "commands/CommandContext.h"

#include <optional>
#include <string>
#include <vector>

namespace zebhost
{

// Shows a scan's progress, keeps what became of each plug-in, and prints it in the end.
class ScanReport : public IScanObserver
{
public:
    ScanReport(const CommandContext& context, const ScanPlan& plan);

    void Stepping(const zebaudiofilterhost::PluginLocator& locator, const std::string& detail, std::size_t current,
                  std::size_t total) override;
    void Finished(const zebaudiofilterhost::PluginLocator& locator, const Outcome& outcome) override;
    bool ShallStop() const override;

    // How many plug-ins the scan has done with.
    std::size_t CountFinished() const { return mFinished; }
    // Of the first of these paths, if they name a bundle, that is not in the catalogue now; none if all are.
    std::optional<Failure> FailureOf(const std::vector<std::string>& paths) const;

    // Of a scan that took place.
    void Print(const std::optional<Failure>& trouble, std::size_t restarts);
    std::string Summary() const;
    // Of one that did not.
    void PrintPlan();
    std::string PlanSummary() const;

private:
    struct Result
    {
        std::string path;
        std::string place; // for the user's eyes
        std::string state;
        std::string detail;
        std::size_t effects = 0;
        std::optional<Failure> failure; // what is told if it was asked for by its path
    };

    void Add(const std::vector<ScanPlan::Item>& items, const char* state);
    // What to do when there was nothing to scan.
    std::string WhatElse() const;
    std::size_t Count(const char* state) const;
    void Print(Json document) const;

    const CommandContext& mContext;
    const ScanPlan& mPlan;
    std::vector<Result> mResults;
    std::size_t mFinished = 0;
};

} // namespace zebhost
