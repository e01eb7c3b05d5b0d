#include "catalogue/BlockReasons.h"

#include <array>
#include <ctime>

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

namespace
{

constexpr const char* kReason = "reason";
constexpr const char* kSince = "since";
constexpr const char* kBinary = "binary";
constexpr const char* kAtHand = "atHand";
constexpr const char* kKnown = "known";
constexpr const char* kVisit = "visit";
constexpr const char* kByHand = "byHand";

bool FlagIn(const Json& entry, const char* name)
{
    return entry.value(name, Json()) == true;
}

} // namespace

std::string TimeOfNow()
{
    const std::time_t now = std::time(nullptr);
    std::tm parts{};
    gmtime_r(&now, &parts);
    std::array<char, 32> text{};
    std::strftime(text.data(), text.size(), "%Y-%m-%dT%H:%M:%SZ", &parts);
    return text.data();
}

Json ToJson(const BlockReason& reason)
{
    Json entry{{kReason, reason.reason}, {kSince, reason.since}};
    if (!reason.binary.IsEmpty())
    {
        entry[kBinary] = ToJson(reason.binary);
    }
    if (reason.isAtHand)
    {
        entry[kAtHand] = true;
        entry[kKnown] = reason.wasKnown;
        entry[kVisit] = reason.visit;
    }
    if (reason.isByHand)
    {
        entry[kByHand] = true;
    }
    return entry;
}

BlockReason BlockReasonIn(const Json& entry)
{
    return {TextIn(entry, kReason), TextIn(entry, kSince), StampIn(entry),        FlagIn(entry, kAtHand),
            FlagIn(entry, kKnown),  TextIn(entry, kVisit), FlagIn(entry, kByHand)};
}

BlockReasons::BlockReasons(const std::filesystem::path& file) : mTable(file, "blocked")
{
}

void BlockReasons::Set(const PluginLocator& locator, const BlockReason& reason)
{
    mTable.Set(locator, ToJson(reason));
}

BlockReason BlockReasons::Get(const PluginLocator& locator) const
{
    const Json* const entry = mTable.Find(locator);
    return entry == nullptr ? BlockReason() : BlockReasonIn(*entry);
}

} // namespace zebhost
