#include "output/JsonDocument.h"

namespace zebhost
{

Json NewDocument(std::string_view command)
{
    return Json{{"schema", kJsonSchema}, {"command", command}, {"ok", true}};
}

Json FailureDocument(std::string_view command, const Failure& failure)
{
    Json document = NewDocument(command);
    document["ok"] = false;
    document["error"] = Json{{"code", static_cast<int>(failure.Code())},
                             {"kind", ExitCodeName(failure.Code())},
                             {"message", failure.what()},
                             {"details", failure.Details()}};
    return document;
}

std::string ToText(const Json& document)
{
    return document.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

std::string ToLine(const Json& document)
{
    return document.dump(-1, ' ', false, Json::error_handler_t::replace) + "\n";
}

} // namespace zebhost
