#include "cli/CommandTableParts.h"

namespace zebhost
{

namespace
{

OperandSpec PluginOperand()
{
    return {"PLUGIN", "a plug-in's path, or one of the catalogue by file name, or by name or ID of a filter",
            Values::Plugin};
}

} // namespace

std::vector<CommandSpec> BlockCommands()
{
    CommandSpec block = {
        "block",
        "keep a plug-in from being scanned or used",
        "A blocked plug-in is not searched, scanned or loaded. Its effects leave the catalogue with the next scan.",
        {PluginOperand()},
        {{"reason", "TEXT", "why, for those who read the list later", Values::Text}},
        {{"zebhost block ~/.vst3/Shaky.vst3 --reason 'hangs on load'", "by path"},
         {"zebhost block Shaky", "by the name of one of its effects"}},
    };
    CommandSpec unblock = {
        "unblock",
        "let a blocked plug-in be used again",
        "The next scan tries it.",
        {{"PLUGIN", "a path, a name or an ID, as 'zebhost blocks' shows it, or a file name", Values::Blocked}},
        {},
        {{"zebhost unblock ~/.vst3/Shaky.vst3", "by path"}, {"zebhost unblock Shaky.vst3", "by file name"}},
    };
    CommandSpec blocks = {
        "blocks",
        "list blocked plug-ins with the reason",
        "",
        {},
        {{"names", "", "print what 'zebhost unblock' takes only, one a line"}},
        {{"zebhost blocks", "for reading"}, {"zebhost blocks --json", "for a script"}},
    };
    return {block, unblock, blocks};
}

std::vector<CommandSpec> ShellCommands()
{
    CommandSpec console = {
        "console",
        "run one of the library's console commands",
        "Without NAME the commands are listed. The ARGUMENTS reach the command as one text with blanks between them, "
        "and what it writes is printed as it stands; so its usage, when it does not take the ARGUMENTS, is no "
        "failure "
        "of zebhost's. Give full paths.",
        {{"NAME", "the command's name", Values::ConsoleCommand, false},
         {"ARGUMENTS", "what the command wants", Values::Text, false, true}},
        {{"names", "", "print the names only, one a line"}},
        {{"zebhost console", "list the commands"},
         {"zebhost console zebaudiofilterhost.BuildPrivatePluginConfig "
          "\"$PWD/Zeb/PrivatePluginConfig,$PWD/Zeb/Plug-Ins\"",
          "catalogue the VST 3 effects that an application ships in its own folder"}},
    };
    CommandSpec completion = {
        "completion",
        "print a completion script for a shell",
        "",
        {{"SHELL", "bash, zsh or fish", Values::Choice, true, false, {"bash", "zsh", "fish"}}},
        {},
        {{"source <(zebhost completion bash)", "for this shell only"},
         {"zebhost completion fish > ~/.config/fish/completions/zebhost.fish", "for good"}},
    };
    CommandSpec man = {
        "man",
        "print the manual page",
        "",
        {},
        {},
        {{"zebhost man | man -l -", "read it"}, {"zebhost man > /usr/local/share/man/man1/zebhost.1", "install it"}},
    };
    return {console, completion, man};
}

} // namespace zebhost
