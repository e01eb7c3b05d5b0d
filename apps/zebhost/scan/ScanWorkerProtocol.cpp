#include "scan/ScanWorkerProtocol.h"

#include "catalogue/LocatorTable.h"
#include "catalogue/LocatorText.h"

namespace zebhost::protocol
{

using zebaudiofilterhost::PluginLocator;

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

std::string ScanLine(const PluginLocator& locator)
{
    return ToLine(Json{{kScan, LocatorText(locator)}});
}

std::optional<PluginLocator> ParseScan(const std::string& line)
{
    const Json message = Json::parse(line, nullptr, false);
    return message.is_object() ? ParseLocatorText(TextIn(message, kScan)) : std::nullopt;
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
