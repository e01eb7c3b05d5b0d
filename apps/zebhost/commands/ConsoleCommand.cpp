#include "cli/Failure.h"
#include "commands/Commands.h"
#include "filter/CrashGuard.h"
#include "output/PrintableText.h"
#include "output/Strings.h"
#include "output/TextTable.h"

#include <foundation/zebcore/CommandRegistry.h>
#include <foundation/zebcore/FileExceptions.h>

#include <algorithm>

namespace zebhost
{

using zebcore::UTF16String;
using zebcore::console::CommandRegistry;

namespace
{

// The library's descriptions begin with the name, which stands beside them here.
std::string Help(const UTF16String& name, const UTF16String& description)
{
    const UTF16String start = name + u" - ";
    return Printable(description.starts_with(start) ? description.substr(start.size()) : description);
}

void ListCommands(const CommandContext& context)
{
    Json document = context.NewDocument();
    document["commands"] = Json::array();
    TextTable table({"NAME", "DESCRIPTION"});
    std::string names;
    for (const auto& [name, description] : CommandRegistry::GetCommands())
    {
        document["commands"].push_back(Json{{"name", ToUTF8(name)}, {"description", Help(name, description)}});
        table.AddRow({Printable(name), Help(name, description)});
        names += Printable(name) + "\n";
    }
    if (context.WantsJson())
    {
        context.Print(document);
        return;
    }
    context.console.Print(context.arguments.Has("names") ? names : table.Text(context.console.HasOutputColour()));
}

bool IsRegistered(const UTF16String& name)
{
    const auto commands = CommandRegistry::GetCommands();
    return std::any_of(commands.begin(), commands.end(), [&name](const auto& each) { return each.first == name; });
}

// What the command has written.
std::string Execute(const std::string& name, const std::string& text)
{
    const CrashGuard guard("the console command " + name,
                           "a plug-in that it loads is to blame, and 'zebhost scan FOLDER' tells which");
    zebcore::utility::oUTF16StringStream output;
    try
    {
        CommandRegistry::ExecuteCommand(FromUTF8(name), FromUTF8(text), output);
    }
    catch (const zebcore::filesupport::file_exception& error)
    {
        throw Failure(ExitCode::FileTrouble,
                      std::string(error.what()) + ": make room, or name a place that can be written");
    }
    return ToUTF8(output.str());
}

} // namespace

ExitCode RunConsole(CommandContext& context)
{
    const std::string name = context.arguments.Text("NAME");
    if (name.empty())
    {
        ListCommands(context);
        return ExitCode::Done;
    }
    if (!IsRegistered(FromUTF8(name)))
    {
        throw Failure(ExitCode::NotFound, "there is no console command '" + name + "': 'zebhost console' lists them");
    }
    const std::string text = Execute(name, Joined(context.arguments.All("ARGUMENTS"), " "));
    if (context.WantsJson())
    {
        Json document = context.NewDocument();
        document["name"] = name;
        document["output"] = text;
        context.Print(document);
    }
    else
    {
        context.console.Print(text);
    }
    return ExitCode::Done;
}

} // namespace zebhost
