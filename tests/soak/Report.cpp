#include "Report.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <fstream>

namespace soak
{

namespace
{

using Json = nlohmann::ordered_json;

constexpr std::size_t kMostNamed = 5;

std::string Joined(const std::vector<std::string>& names)
{
    std::string text;
    for (const std::string& name : names)
    {
        text += (text.empty() ? "" : ", ") + name;
    }
    return text;
}

Json ToJson(const Ledger::Account& account)
{
    return {{"effect", account.name},
            {"turns", account.turns},
            {"filters", account.lives},
            {"editors", account.editors},
            {"grownBytes", account.growth},
            {"bytesPerFilter", account.PerLife()},
            {"residentBytes", account.resident},
            {"descriptors", account.descriptors},
            {"threads", account.threads}};
}

Json ToJson(const Sample& sample)
{
    return {{"seconds", sample.seconds},
            {"resident", sample.resources.resident},
            {"inUse", sample.resources.inUse},
            {"descriptors", sample.resources.descriptors},
            {"threads", sample.resources.threads}};
}

Json ToJson(const Throws::Entry& entry)
{
    return {{"effect", entry.effect},    {"operation", entry.step},    {"type", entry.thrown.type},
            {"what", entry.thrown.what}, {"ofThisProject", entry.own}, {"times", entry.times}};
}

Json ToJson(const Check& check)
{
    return {{"what", check.what}, {"figures", check.figures}, {"outcome", NameOf(check.outcome)}};
}

template <typename Item>
Json ArrayOf(const std::vector<Item>& items)
{
    Json array = Json::array();
    for (const Item& item : items)
    {
        array.push_back(ToJson(item));
    }
    return array;
}

Json TallyJson(const Tally& tally)
{
    Json counts = Json::object();
    for (std::size_t kind = 0; kind < kOperations; ++kind)
    {
        counts[NameOf(static_cast<Operation>(kind))] = tally[kind];
    }
    return counts;
}

void SayWhatWasThrown(const Console& console, const std::vector<Throws::Entry>& entries)
{
    constexpr std::size_t kMostLines = 20;
    for (std::size_t index = 0; index < std::min(entries.size(), kMostLines); ++index)
    {
        const Throws::Entry& entry = entries[index];
        console.Say("soak: " + entry.effect + " threw " + entry.thrown.type +
                    (entry.thrown.what.empty() ? "" : " (" + entry.thrown.what + ")") + ", " + entry.step + ", " +
                    std::to_string(entry.times) + (entry.times == 1 ? " time" : " times"));
    }
    if (entries.size() > kMostLines)
    {
        console.Say("soak: and " + std::to_string(entries.size() - kMostLines) + " more lines like these");
    }
}

void SayWhatStays(const Console& console, const Ledger& ledger, std::ptrdiff_t Ledger::Account::*kind)
{
    for (const Ledger::Account& account : ledger.Worst(kMostNamed, kind))
    {
        console.Say("soak: " + account.name + ", alone, has left " + std::to_string(account.growth) +
                    " bytes of the heap, " + std::to_string(account.resident) + " of resident memory, " +
                    std::to_string(account.descriptors) + " descriptors and " + std::to_string(account.threads) +
                    " threads behind, after " + std::to_string(account.lives) + " filters and " +
                    std::to_string(account.editors) + " editors");
    }
}

} // namespace

void SayFindings(const Console& console, const Findings& findings)
{
    SayWhatStays(console, findings.ledger, &Ledger::Account::growth);
    SayWhatStays(console, findings.ledger, &Ledger::Account::resident);
    SayWhatWasThrown(console, findings.score.throws.Entries());
    if (!findings.leftOut.empty())
    {
        console.Say("soak: did not take part, as asked for: " + Joined(findings.leftOut));
    }
    if (!findings.varying.empty())
    {
        console.Say("soak: not the same sound twice from the start, so not compared: " + Joined(findings.varying));
    }
    if (!findings.changed.empty())
    {
        console.Say("soak: another sound at the end: " + Joined(findings.changed));
    }
    for (const Check& check : findings.checks)
    {
        console.Say("soak: " + check.what + ": " + check.figures + ": " + NameOf(check.outcome));
    }
    console.Say(findings.Passed() ? "soak: passed" : "soak: FAILED");
}

void WriteJson(const Options& options, const Findings& findings)
{
    if (options.json.empty())
    {
        return;
    }
    const Json document = {{"randomStart", options.randomStart},
                           {"seconds", findings.seconds},
                           {"passed", findings.Passed()},
                           {"operations", TallyJson(findings.score.tally)},
                           {"checks", ArrayOf(findings.checks)},
                           {"notDeterministic", findings.varying},
                           {"changedSound", findings.changed},
                           {"leftOut", findings.leftOut},
                           {"threw", ArrayOf(findings.score.throws.Entries())},
                           {"firstUse", ArrayOf(findings.firstUse.Accounts())},
                           {"leftBehind", ArrayOf(findings.ledger.Accounts())},
                           {"samples", ArrayOf(findings.samples)}};
    std::ofstream(options.json) << document.dump(1, ' ', false, Json::error_handler_t::replace) << '\n';
}

} // namespace soak
