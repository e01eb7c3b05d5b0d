#include "scan/ScanWorkerProtocol.h"

#include "catalogue/LocatorTable.h"

#include <foundation/zebcore/PropList.h>
#include <foundation/zebcore/PropListUtils.h>

namespace zebhost::protocol
{

using zebaudiofilterhost::PluginLocator;
using zebcore::proplist::PropList;

namespace
{

constexpr const char* kScan = "scan";
constexpr const char* kReady = "ready";
constexpr const char* kStep = "step";
constexpr const char* kResult = "result";
constexpr const char* kLoaded = "loaded";
constexpr const char* kEffects = "effects";
constexpr const char* kProblem = "problem";
constexpr const char* kFound = "found";
const zebcore::UTF8String kLocator = u8"locator";

IScanObserver::Outcome OutcomeIn(const Json& result)
{
    IScanObserver::Outcome outcome;
    outcome.loaded = result.value(kLoaded, Json()) == true;
    const Json effects = result.value(kEffects, Json());
    outcome.effects = effects.is_number_unsigned() ? effects.get<std::size_t>() : 0;
    outcome.problem = TextIn(result, kProblem);
    outcome.end = outcome.loaded ? IScanObserver::End::Scanned : IScanObserver::End::Failed;
    return outcome;
}

} // namespace

// A path need not be text that JSON can hold; a property list holds anything.
std::string ScanLine(const PluginLocator& locator)
{
    PropList list;
    list.SetValue(kLocator, locator.ToString());
    zebcore::UTF8String text;
    zebcore::proplist::utils::WritePropList(text, list);
    return ToLine(Json{{kScan, std::string(text.begin(), text.end())}});
}

std::optional<PluginLocator> ParseScan(const std::string& line)
{
    const Json message = Json::parse(line, nullptr, false);
    const std::string text = message.is_object() ? TextIn(message, kScan) : std::string();
    PropList list;
    zebcore::UTF16String locatorText;
    if (!zebcore::proplist::utils::ReadPropList({text.begin(), text.end()}, list) ||
        !list.GetValue(kLocator, locatorText))
    {
        return std::nullopt;
    }
    PluginLocator locator;
    locator.FromString(locatorText);
    return locator;
}

std::string ReadyLine()
{
    return ToLine(Json{{kReady, true}});
}

std::string StepLine(std::string_view detail)
{
    return ToLine(Json{{kStep, detail}});
}

std::string ResultLine(const IScanObserver::Outcome& outcome, const zebcore::UTF8String& found)
{
    return ToLine(Json{{kResult, Json{{kLoaded, outcome.loaded},
                                      {kEffects, outcome.effects},
                                      {kProblem, outcome.problem},
                                      {kFound, std::string(found.begin(), found.end())}}}});
}

Message ParseMessage(const std::string& line)
{
    Message message;
    const Json json = Json::parse(line, nullptr, false);
    if (!json.is_object() || json.size() != 1)
    {
        return message;
    }
    if (json.contains(kReady))
    {
        message.kind = Message::Kind::Ready;
    }
    else if (json.contains(kStep))
    {
        message.kind = Message::Kind::Step;
        message.detail = TextIn(json, kStep);
    }
    else if (json.contains(kResult) && json[kResult].is_object())
    {
        message.kind = Message::Kind::Result;
        message.outcome = OutcomeIn(json[kResult]);
        const std::string found = TextIn(json[kResult], kFound);
        message.found.assign(found.begin(), found.end());
    }
    return message;
}

} // namespace zebhost::protocol
