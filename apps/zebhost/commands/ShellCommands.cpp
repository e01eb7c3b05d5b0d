#include "cli/ManPage.h"
#include "cli/ShellCompletion.h"
#include "commands/Commands.h"
#include "output/JsonDocument.h"

namespace zebhost
{

namespace
{

void PrintText(const Arguments& arguments, Console& console, const std::string& text)
{
    if (!arguments.Has("json"))
    {
        console.Print(text);
        return;
    }
    Json document = NewDocument(arguments.command);
    document["text"] = text;
    console.Print(ToText(document));
}

} // namespace

ExitCode RunCompletion(const Arguments& arguments, Console& console)
{
    PrintText(arguments, console, ShellCompletion(arguments.Text("SHELL")));
    return ExitCode::Done;
}

ExitCode RunMan(const Arguments& arguments, Console& console)
{
    PrintText(arguments, console, ManPage(ZEBHOST_VERSION));
    return ExitCode::Done;
}

} // namespace zebhost
