#pragma once

#include "catalogue/Catalogue.h"
#include "catalogue/SettingsFolder.h"
#include "cli/Arguments.h"
#include "output/Console.h"
#include "output/JsonDocument.h"

namespace zebhost
{

// What a command works with. The catalogue is loaded, and nobody else changes its files while a command does that
// may.
struct CommandContext
{
    const Arguments& arguments;
    Console& console;
    Catalogue& catalogue;

    bool WantsJson() const { return arguments.Has("json"); }
    Json NewDocument() const { return zebhost::NewDocument(arguments.command); }
    void Print(const Json& document) const { console.Print(ToText(document)); }
};

} // namespace zebhost
