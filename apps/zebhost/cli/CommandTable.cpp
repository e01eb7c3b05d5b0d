#include "cli/CommandTable.h"

#include "cli/CommandTableParts.h"

#include <algorithm>
#include <iterator>

namespace zebhost
{

namespace
{

std::vector<CommandSpec> AllOf(std::initializer_list<std::vector<CommandSpec>> groups)
{
    std::vector<CommandSpec> all;
    for (const std::vector<CommandSpec>& group : groups)
    {
        std::copy(group.begin(), group.end(), std::back_inserter(all));
    }
    return all;
}

} // namespace

const std::vector<CommandSpec>& CommandTable()
{
    static const std::vector<CommandSpec> sTable = AllOf({CatalogueCommands(), RenderCommands(), PresetCommands(),
                                                          EditorCommands(), BlockCommands(), ShellCommands()});
    return sTable;
}

const std::vector<OptionSpec>& CommonOptions()
{
    static const std::vector<OptionSpec> sOptions = {
        {"settings", "DIR", "keep catalogue, block lists and presets in DIR instead of the preference folder",
         Values::Folder},
        {"json", "", "print one JSON document on standard output"},
        {"quiet", "", "no progress and no remarks on standard error"},
        {"trace", "CATEGORY", "write the library's trace lines of CATEGORY to standard error; \"all\" for every one",
         Values::Text, true},
    };
    return sOptions;
}

const CommandSpec* FindCommand(std::string_view name)
{
    const std::vector<CommandSpec>& table = CommandTable();
    const auto found =
        std::find_if(table.begin(), table.end(), [name](const CommandSpec& command) { return command.name == name; });
    return found == table.end() ? nullptr : &*found;
}

} // namespace zebhost
