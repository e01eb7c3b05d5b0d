#include "catalogue/ScanFact.h"

#include "catalogue/LocatorText.h"

namespace zebhost
{

using zebaudiofilterhost::PluginLocator;

namespace
{

constexpr const char* kPlugin = "plugin";
constexpr const char* kBlock = "block";
constexpr const char* kResult = "result";
constexpr const char* kFound = "found";
constexpr const char* kForgotten = "forgotten";

bool HasObject(const Json& json, const char* name)
{
    const auto found = json.find(name);
    return found != json.end() && found->is_object();
}

} // namespace

std::string ToLine(const ScanFact& fact)
{
    Json json{{kPlugin, LocatorText(fact.plugin)}};
    if (fact.block)
    {
        json[kBlock] = ToJson(*fact.block);
    }
    if (fact.result)
    {
        json[kResult] = BinaryStamps::ToJson(*fact.result);
    }
    if (!fact.found.empty())
    {
        json[kFound] = std::string(fact.found.begin(), fact.found.end());
    }
    if (fact.isForgotten)
    {
        json[kForgotten] = true;
    }
    return ToLine(json);
}

std::optional<ScanFact> ParseScanFact(const std::string& line)
{
    const Json json = Json::parse(line, nullptr, false);
    const std::optional<PluginLocator> plugin =
        json.is_object() ? ParseLocatorText(TextIn(json, kPlugin)) : std::nullopt;
    if (!plugin)
    {
        return std::nullopt;
    }
    ScanFact fact;
    fact.plugin = *plugin;
    if (HasObject(json, kBlock))
    {
        fact.block = BlockReasonIn(json[kBlock]);
    }
    if (HasObject(json, kResult))
    {
        fact.result = BinaryStamps::EntryIn(json[kResult]);
    }
    const std::string found = TextIn(json, kFound);
    fact.found.assign(found.begin(), found.end());
    fact.isForgotten = json.value(kForgotten, Json()) == true;
    return fact;
}

} // namespace zebhost
