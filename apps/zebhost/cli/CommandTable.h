#pragma once

#include <string_view>
#include <vector>

namespace zebhost
{

// What stands in the place of a value, so that a shell can complete it.
enum class Values
{
    None, // a flag
    Text,
    Number,
    File,
    Folder,
    Filter,
    Plugin,
    Blocked,
    ConsoleCommand,
    Choice
};

struct OptionSpec
{
    std::string_view name;        // without the dashes
    std::string_view placeholder; // empty for a flag
    std::string_view help;
    Values values = Values::None;
    bool repeatable = false;
    std::vector<std::string_view> choices = {};
};

struct OperandSpec
{
    std::string_view name;
    std::string_view help;
    Values values = Values::Text;
    bool required = true;
    bool repeatable = false;
    std::vector<std::string_view> choices = {};
};

struct ExampleSpec
{
    std::string_view line;
    std::string_view meaning;
};

struct CommandSpec
{
    std::string_view name; // one or two words
    std::string_view summary;
    std::string_view description;
    std::vector<OperandSpec> operands;
    std::vector<OptionSpec> options;
    std::vector<ExampleSpec> examples;
};

// The one table that the parser, the help texts, the shell completion and the man page are made from.
const std::vector<CommandSpec>& CommandTable();

// Options that every command takes.
const std::vector<OptionSpec>& CommonOptions();

// Null if there is no such command.
const CommandSpec* FindCommand(std::string_view name);

} // namespace zebhost
