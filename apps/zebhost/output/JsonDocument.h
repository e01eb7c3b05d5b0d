#pragma once

#include "cli/Failure.h"

#include <nlohmann/json.hpp>

#include <string>
#include <string_view>

namespace zebhost
{

// Keys come out in the order in which they were set.
using Json = nlohmann::ordered_json;

// Grows when a key changes its meaning or goes away; new keys leave it as it is.
inline constexpr int kJsonSchema = 1;

// What every document begins with: "schema", "command", "ok" true.
Json NewDocument(std::string_view command);

// The document of a command that failed: "ok" false, and "error" with "code", "kind", "message" and "details".
Json FailureDocument(std::string_view command, const Failure& failure);

// As text that is valid UTF-8 whatever bytes went in, with a line end.
std::string ToText(const Json& document);
// The same in one line.
std::string ToLine(const Json& document);

} // namespace zebhost
