#include "foundation/zebcore/CommandRegistry.h"

#include <map>

namespace zebcore::console
{

namespace
{

struct Entry
{
    UTF16String mDescription;
    CommandRegistry::Creator mCreator;
    std::shared_ptr<Command> mCommand; // null until it is needed
};

std::map<UTF16String, Entry>& Entries()
{
    // Never destroyed: an application's own statics may terminate the module as they go.
    static auto& sEntries = *new std::map<UTF16String, Entry>;
    return sEntries;
}

} // namespace

void CommandRegistry::RegisterCommand(const UTF16String& name, const UTF16String& description, const Creator& creator)
{
    Entries().insert_or_assign(name, Entry{description, creator, nullptr});
}

void CommandRegistry::UnregisterCommand(const UTF16String& name)
{
    Entries().erase(name);
}

bool CommandRegistry::ExecuteCommand(const UTF16String& name, const UTF16String& arguments,
                                     utility::UTF16OutputStream& output)
{
    const auto found = Entries().find(name);
    if (found == Entries().end())
        return false;
    Entry& entry = found->second;
    if (!entry.mCommand && entry.mCreator)
        entry.mCommand = entry.mCreator(name, entry.mDescription);
    // A copy, since the command may unregister itself.
    const std::shared_ptr<Command> command = entry.mCommand;
    if (!command)
        return false;
    command->Execute(arguments, output);
    return true;
}

std::vector<std::pair<UTF16String, UTF16String>> CommandRegistry::GetCommands()
{
    std::vector<std::pair<UTF16String, UTF16String>> commands;
    for (const auto& [name, entry] : Entries())
        commands.emplace_back(name, entry.mDescription);
    return commands;
}

} // namespace zebcore::console
