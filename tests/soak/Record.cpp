#include "Record.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace soak
{

namespace
{

constexpr std::size_t kLeastInQuarter = 8;
constexpr double kShortestSeconds = 60.0; // caches fill for longer than that
constexpr double kMostGrowth = 1.05;

double Median(std::vector<double> values)
{
    const auto middle = values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2);
    std::nth_element(values.begin(), middle, values.end());
    return *middle;
}

Check JudgeMemory(const std::string& what, const std::vector<Sample>& samples, std::size_t Resources::*member)
{
    const double whole = samples.back().seconds;
    std::vector<double> first;
    std::vector<double> last;
    for (const Sample& sample : samples)
    {
        const auto value = static_cast<double>(sample.resources.*member);
        if (sample.seconds <= whole * 0.25)
        {
            first.push_back(value);
        }
        else if (sample.seconds >= whole * 0.75)
        {
            last.push_back(value);
        }
    }
    if (whole < kShortestSeconds || std::min(first.size(), last.size()) < kLeastInQuarter)
    {
        return {what, "too short a run", Check::Outcome::NotJudged};
    }
    std::array<char, 32> ratio{};
    const double growth = Median(last) / Median(first);
    std::snprintf(ratio.data(), ratio.size(), "%.4f", growth);
    return {what, Megabytes(Median(first)) + " to " + Megabytes(Median(last)) + ", ratio " + ratio.data(),
            growth <= kMostGrowth ? Check::Outcome::Holds : Check::Outcome::Fails};
}

Check JudgeCount(const std::string& what, const std::vector<Sample>& samples, int Resources::*member)
{
    const int first = samples.front().resources.*member;
    const int last = samples.back().resources.*member;
    return {what, std::to_string(first) + " to " + std::to_string(last),
            first == last ? Check::Outcome::Holds : Check::Outcome::Fails};
}

} // namespace

const char* NameOf(Check::Outcome outcome)
{
    switch (outcome)
    {
    case Check::Outcome::Holds:
        return "holds";
    case Check::Outcome::Fails:
        return "FAILS";
    default:
        return "not judged";
    }
}

std::vector<Check> JudgeResources(const std::vector<Sample>& samples)
{
    if (samples.empty())
    {
        return {};
    }
    return {JudgeMemory("resident memory, medians of the first and the last quarter", samples, &Resources::resident),
            JudgeMemory("heap in use, medians of the first and the last quarter", samples, &Resources::inUse),
            JudgeCount("open descriptors at both ends", samples, &Resources::descriptors),
            JudgeCount("threads at both ends", samples, &Resources::threads)};
}

Check JudgeSubjects(std::size_t effects)
{
    return {"effects beside the control", std::to_string(effects),
            effects > 0 ? Check::Outcome::Holds : Check::Outcome::Fails};
}

Check JudgeEnd(bool interrupted)
{
    return {"the whole run", interrupted ? "interrupted" : "to its end",
            interrupted ? Check::Outcome::Fails : Check::Outcome::Holds};
}

Check JudgeThrows(std::size_t own, unsigned long byOwn, unsigned long byOthers)
{
    return {"exceptions from the " + std::to_string(own) + " effects of this project",
            std::to_string(byOwn) + ", from others " + std::to_string(byOthers),
            byOwn == 0 ? Check::Outcome::Holds : Check::Outcome::Fails};
}

Check JudgeProbes(std::size_t compared, std::size_t different)
{
    Check check{"fixed probes at both ends",
                std::to_string(compared) + " compared, " + std::to_string(different) + " different"};
    if (compared == 0)
    {
        check.outcome = Check::Outcome::NotJudged;
    }
    else if (different > 0)
    {
        check.outcome = Check::Outcome::Fails;
    }
    return check;
}

bool AllHold(const std::vector<Check>& checks)
{
    const auto fails = [](const Check& check)
    {
        return check.outcome == Check::Outcome::Fails;
    };
    const auto holds = [](const Check& check)
    {
        return check.outcome == Check::Outcome::Holds;
    };
    return std::none_of(checks.begin(), checks.end(), fails) && std::any_of(checks.begin(), checks.end(), holds);
}

std::string Megabytes(double bytes)
{
    std::array<char, 32> text{};
    std::snprintf(text.data(), text.size(), "%.1f MB", bytes / 1e6);
    return text.data();
}

} // namespace soak
