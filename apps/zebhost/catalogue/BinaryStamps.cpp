#include "catalogue/BinaryStamps.h"

#include "catalogue/LocatorText.h"

#include <utility>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

namespace
{

// Holds the locator, which the key of its entry does not give back.
constexpr const char* kToBeTried = "toBeTried";

} // namespace

BinaryStamps::BinaryStamps(const std::filesystem::path& file) : mTable(file, "binaries")
{
}

Json BinaryStamps::ToJson(const Entry& entry)
{
    Json json{{"binary", zebhost::ToJson(entry.binary)}};
    if (!entry.problem.empty())
    {
        json["problem"] = entry.problem;
    }
    if (!entry.visit.empty())
    {
        json["visit"] = entry.visit;
    }
    return json;
}

BinaryStamps::Entry BinaryStamps::EntryIn(const Json& json)
{
    return {StampIn(json), TextIn(json, "problem"), TextIn(json, "visit")};
}

std::optional<BinaryStamps::Entry> BinaryStamps::Find(const PluginLocator& locator) const
{
    const Json* const entry = mTable.Find(locator);
    return entry == nullptr ? std::nullopt : std::optional(EntryIn(*entry));
}

void BinaryStamps::Set(const PluginLocator& locator, const Entry& entry)
{
    mTable.Set(locator, ToJson(entry));
}

void BinaryStamps::MarkToBeTried(const PluginLocator& locator)
{
    const Json* const before = mTable.Find(locator);
    Json entry = before == nullptr ? Json::object() : *before;
    entry[kToBeTried] = LocatorText(locator);
    mTable.Set(locator, std::move(entry));
}

bool BinaryStamps::IsToBeTried(const PluginLocator& locator) const
{
    const Json* const entry = mTable.Find(locator);
    return entry != nullptr && entry->contains(kToBeTried);
}

std::vector<PluginLocator> BinaryStamps::AllToBeTried() const
{
    std::vector<PluginLocator> locators;
    for (const auto& [key, entry] : mTable.Entries())
    {
        if (const std::optional<PluginLocator> locator = ParseLocatorText(TextIn(entry, kToBeTried)))
        {
            locators.push_back(*locator);
        }
    }
    return locators;
}

} // namespace zebhost
