#include "catalogue/BinaryStamps.h"

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

BinaryStamps::BinaryStamps(const std::filesystem::path& file) : mTable(file, "binaries")
{
}

std::optional<BinaryStamps::Entry> BinaryStamps::Find(const PluginLocator& locator) const
{
    const Json* const entry = mTable.Find(locator);
    if (entry == nullptr)
    {
        return std::nullopt;
    }
    return Entry{StampIn(*entry), TextIn(*entry, "problem"), TextIn(*entry, "visit")};
}

void BinaryStamps::Set(const PluginLocator& locator, const Entry& entry)
{
    Json json{{"binary", ToJson(entry.binary)}};
    if (!entry.problem.empty())
    {
        json["problem"] = entry.problem;
    }
    if (!entry.visit.empty())
    {
        json["visit"] = entry.visit;
    }
    mTable.Set(locator, std::move(json));
}

} // namespace zebhost
