#include "catalogue/BinaryStamps.h"

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

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

} // namespace zebhost
