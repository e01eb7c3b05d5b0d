#include "cli/ArgumentParser.h"

#include "cli/CommandTable.h"
#include "cli/Failure.h"
#include "output/Strings.h"

#include <CLI/CLI.hpp>

#include <algorithm>

namespace zebhost
{

namespace
{

using OptionNames = std::vector<std::pair<CLI::Option*, std::string>>;

struct ParserCommand
{
    const CommandSpec* row = nullptr;
    CLI::App* app = nullptr;
    OptionNames options;
};

CLI::Option* AddOption(CLI::App& app, const OptionSpec& row)
{
    const std::string name = "--" + std::string(row.name);
    if (row.values == Values::None)
    {
        return app.add_flag(name);
    }
    CLI::Option* option = app.add_option(name)->type_size(1)->expected(1)->allow_extra_args(false);
    return option->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
}

// What is missing or too much is told later, in words of our own; so nothing is required here. Extra arguments of an
// option would have brackets around a value taken off, which may stand in a file's name.
CLI::Option* AddOperand(CLI::App& app, const OperandSpec& row)
{
    constexpr int kAnyNumber = 1 << 20;
    CLI::Option* option = app.add_option(std::string(row.name))->type_size(1);
    option->expected(row.repeatable ? kAnyNumber : 1)->allow_extra_args(false);
    return option->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
}

// A command of two words stands below its first word.
CLI::App* AddCommand(CLI::App& root, const CommandSpec& row)
{
    const std::vector<std::string> words = Split(row.name, ' ');
    CLI::App* parent = &root;
    if (words.size() == 2)
    {
        const std::vector<CLI::App*> known =
            root.get_subcommands([&words](CLI::App* app) { return app->get_name() == words.front(); });
        parent = !known.empty() ? known.front()
                                : root.add_subcommand(words.front())->require_subcommand(0, 1)->fallthrough();
    }
    return parent->add_subcommand(words.back())->fallthrough();
}

ParserCommand MakeCommand(CLI::App& root, const CommandSpec& row)
{
    ParserCommand command{&row, AddCommand(root, row), {}};
    for (const OperandSpec& operand : row.operands)
    {
        command.options.emplace_back(AddOperand(*command.app, operand), std::string(operand.name));
    }
    for (const OptionSpec& option : row.options)
    {
        command.options.emplace_back(AddOption(*command.app, option), std::string(option.name));
    }
    return command;
}

void TakeValues(const OptionNames& options, Arguments& arguments)
{
    for (const auto& [option, name] : options)
    {
        if (option->count() > 0)
        {
            arguments.Add(name, option->results());
        }
    }
}

// "preset" alone has no row in the table, but may be asked for help.
std::string ParsedCommandName(const CLI::App& root)
{
    std::vector<std::string> words;
    for (const CLI::App* app = &root; !app->get_subcommands().empty();)
    {
        app = app->get_subcommands().front();
        words.push_back(app->get_name());
    }
    return Joined(words, " ");
}

[[noreturn]] void RefuseUsage(const std::string& what, const std::string& command)
{
    const std::string help = command.empty() ? "zebhost --help" : "zebhost " + command + " --help";
    throw Failure(ExitCode::Usage, what + "; see '" + help + "'");
}

// No command has a use for an empty text: it is what a variable without a value leaves behind in a script.
void CheckNotEmpty(const std::string& what, std::string_view name, const std::string& advice,
                   const Arguments& arguments)
{
    const std::vector<std::string> given = arguments.All(name);
    if (std::find(given.begin(), given.end(), "") != given.end())
    {
        RefuseUsage(what + " is empty: give " + advice, arguments.command);
    }
}

void CheckOptions(const std::vector<OptionSpec>& options, const Arguments& arguments)
{
    for (const OptionSpec& option : options)
    {
        const std::string dashed = "--" + std::string(option.name);
        const std::vector<std::string> given = arguments.All(option.name);
        CheckNotEmpty(dashed, option.name, std::string(option.placeholder) + ", or leave it out", arguments);
        if (option.values == Values::None &&
            std::any_of(given.begin(), given.end(), [](const std::string& value) { return value != "true"; }))
        {
            RefuseUsage(dashed + " takes no value", arguments.command);
        }
        if (option.values != Values::None && !option.repeatable && given.size() > 1)
        {
            RefuseUsage(dashed + " is given " + std::to_string(given.size()) + " times: give it once",
                        arguments.command);
        }
    }
}

void CheckChoice(std::string_view what, const std::vector<std::string>& given,
                 const std::vector<std::string_view>& choices)
{
    for (const std::string& value : given)
    {
        if (std::find(choices.begin(), choices.end(), value) == choices.end())
        {
            throw Failure(ExitCode::Usage, std::string(what) + " " + value + ": give one of " +
                                               Joined({choices.begin(), choices.end()}, ", "));
        }
    }
}

void CheckChoices(const CommandSpec& row, const Arguments& arguments)
{
    for (const OptionSpec& option : row.options)
    {
        if (option.values == Values::Choice)
        {
            CheckChoice("--" + std::string(option.name), arguments.All(option.name), option.choices);
        }
    }
    for (const OperandSpec& operand : row.operands)
    {
        if (operand.values == Values::Choice)
        {
            CheckChoice(operand.name, arguments.All(operand.name), operand.choices);
        }
    }
}

void CheckOperands(const CommandSpec& row, const Arguments& arguments)
{
    for (const OperandSpec& operand : row.operands)
    {
        if (operand.required && !arguments.Has(operand.name))
        {
            RefuseUsage(std::string(operand.name) + " is missing: give " + std::string(operand.help),
                        arguments.command);
        }
        CheckNotEmpty(std::string(operand.name), operand.name, std::string(operand.help), arguments);
    }
}

// The parser's tree of commands, and where each value goes.
class Parser
{
public:
    Parser()
    {
        mRoot.require_subcommand(0, 1);
        mRoot.set_help_flag("-h,--help");
        mRoot.set_version_flag("--version", std::string("zebhost"));
        for (const OptionSpec& option : CommonOptions())
        {
            mCommon.emplace_back(AddOption(mRoot, option), std::string(option.name));
        }
        for (const CommandSpec& row : CommandTable())
        {
            mCommands.push_back(MakeCommand(mRoot, row));
        }
    }

    Arguments Parse(int argc, const char* const* argv)
    {
        Arguments arguments;
        try
        {
            mRoot.parse(argc, argv);
        }
        catch (const CLI::CallForHelp&)
        {
            arguments.Add("help", {});
            RefuseUnknownCommand();
        }
        catch (const CLI::CallForVersion&)
        {
            arguments.Add("version", {});
        }
        catch (const CLI::ExtrasError&)
        {
            RefuseExtras();
        }
        // An option at the end of the line: all other numbers of values are taken here.
        catch (const CLI::ArgumentMismatch& error)
        {
            const std::string text = error.what();
            RefuseUsage(text.substr(0, text.find(':')) + " needs a value", ParsedCommandName(mRoot));
        }
        catch (const CLI::ParseError& error)
        {
            RefuseUsage(error.what(), ParsedCommandName(mRoot));
        }
        arguments.command = ParsedCommandName(mRoot);
        Collect(arguments);
        return arguments;
    }

private:
    // Help is for what there is.
    void RefuseUnknownCommand() const
    {
        const std::vector<std::string> extras = mRoot.remaining(true);
        if (FindCommand(ParsedCommandName(mRoot)) == nullptr && !extras.empty())
        {
            RefuseExtras();
        }
    }

    [[noreturn]] void RefuseExtras() const
    {
        const std::string command = ParsedCommandName(mRoot);
        const std::vector<std::string> extras = mRoot.remaining(true);
        const std::string first = extras.empty() ? std::string() : extras.front();
        const bool isCommand = FindCommand(command) == nullptr && first.substr(0, 1) != "-";
        RefuseUsage(isCommand ? "there is no command '" + command + (command.empty() ? "" : " ") + first + "'"
                              : "'" + first + "' is not expected here",
                    FindCommand(command) == nullptr ? std::string() : command);
    }

    void Collect(Arguments& arguments) const
    {
        TakeValues(mCommon, arguments);
        const auto command =
            std::find_if(mCommands.begin(), mCommands.end(),
                         [&arguments](const ParserCommand& each) { return each.row->name == arguments.command; });
        if (arguments.Has("help") || arguments.Has("version"))
        {
            return;
        }
        if (command == mCommands.end())
        {
            RefuseUsage(arguments.command.empty() ? "give a command" : arguments.command + " needs a second word",
                        arguments.command);
        }
        TakeValues(command->options, arguments);
        CheckOptions(CommonOptions(), arguments);
        CheckOptions(command->row->options, arguments);
        CheckOperands(*command->row, arguments);
        CheckChoices(*command->row, arguments);
    }

    CLI::App mRoot{"", "zebhost"};
    OptionNames mCommon;
    std::vector<ParserCommand> mCommands;
};

} // namespace

Arguments ParseArguments(int argc, const char* const* argv)
{
    return Parser().Parse(argc, argv);
}

} // namespace zebhost
