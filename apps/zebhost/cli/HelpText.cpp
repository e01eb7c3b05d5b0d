#include "cli/HelpText.h"

#include "output/Strings.h"

#include <algorithm>
#include <vector>

namespace zebhost
{

namespace
{

// Words from `indent` on, broken before `width`; the first line continues one that has reached `column`.
std::string Wrapped(std::string_view text, std::size_t indent, std::size_t column, std::size_t width)
{
    std::string result;
    for (const std::string& word : Split(text, ' '))
    {
        if (column > indent && column + 1 + word.size() > width)
        {
            result += "\n";
            column = 0;
        }
        const std::size_t gap = column < indent ? indent - column : (column == indent ? 0 : 1);
        result.append(gap, ' ').append(word);
        column += gap + word.size();
    }
    return result + "\n";
}

std::string Row(const std::string& head, std::string_view text, std::size_t width)
{
    constexpr std::size_t kTextColumn = 26;
    std::string result = "  " + head;
    if (result.size() + 2 > kTextColumn)
    {
        result += "\n";
        return result + Wrapped(text, kTextColumn, 0, width);
    }
    const std::size_t column = result.size();
    return result + Wrapped(text, kTextColumn, column, width);
}

std::string OptionRows(const std::vector<OptionSpec>& options, std::size_t width)
{
    std::string result;
    for (const OptionSpec& option : options)
    {
        std::string text(option.help);
        if (!option.choices.empty())
        {
            text += ": " + Joined({option.choices.begin(), option.choices.end()}, ", ");
        }
        result += Row(OptionSignature(option), text + (option.repeatable ? " (may be repeated)" : ""), width);
    }
    return result;
}

std::string ExampleRows(const CommandSpec& command)
{
    std::string result;
    for (const ExampleSpec& example : command.examples)
    {
        result += "  " + std::string(example.line) + "\n      " + std::string(example.meaning) + "\n";
    }
    return result;
}

std::string CommandRows(std::string_view firstWord, std::size_t width)
{
    std::string result;
    for (const CommandSpec& command : CommandTable())
    {
        if (firstWord.empty() || Split(command.name, ' ').front() == firstWord)
        {
            result += Row(std::string(command.name), command.summary, width);
        }
    }
    return result;
}

} // namespace

std::string OptionSignature(const OptionSpec& option)
{
    const std::string name = "--" + std::string(option.name);
    return option.placeholder.empty() ? name : name + " " + std::string(option.placeholder);
}

std::string UsageLine(const CommandSpec& command)
{
    std::string line = "zebhost " + std::string(command.name) + " [OPTIONS]";
    for (const OperandSpec& operand : command.operands)
    {
        const std::string name = std::string(operand.name) + (operand.repeatable ? "..." : "");
        line += operand.required ? " " + name : " [" + name + "]";
    }
    return line;
}

std::string OverviewHelp(std::size_t width)
{
    return "zebhost finds audio plug-ins and runs sound files through them.\n\nUsage: zebhost COMMAND [OPTIONS] ...\n"
           "\nCommands:\n" +
           CommandRows({}, width) + "\nOptions of every command:\n" + OptionRows(CommonOptions(), width) +
           Row("--help", "explain a command, with examples", width) + Row("--version", "print the version", width) +
           "\nExamples:\n  zebhost scan && zebhost list\n      see what is installed\n"
           "  zebhost render Gain --set Gain=-6 in.wav out.wav\n      run a sound file through an effect\n"
           "\nExit codes: 0 done, 1 the job failed, 2 usage, 3 not found or ambiguous, 4 could not be loaded,\n"
           "5 crashed or timed out, 6 blocked, 7 file exists or cannot be read or written.\n";
}

std::string CommandHelp(const CommandSpec& command, std::size_t width)
{
    std::string text = "Usage: " + UsageLine(command) + "\n\n" + Wrapped(command.summary, 0, 0, width);
    if (!command.description.empty())
    {
        text += "\n" + Wrapped(command.description, 0, 0, width);
    }
    if (!command.operands.empty())
    {
        text += "\nArguments:\n";
    }
    for (const OperandSpec& operand : command.operands)
    {
        text += Row(std::string(operand.name), operand.help, width);
    }
    if (!command.options.empty())
    {
        text += "\nOptions:\n" + OptionRows(command.options, width);
    }
    text += "\nOptions of every command:\n" + OptionRows(CommonOptions(), width);
    return text + "\nExamples:\n" + ExampleRows(command);
}

std::string HelpFor(std::string_view command, std::size_t width)
{
    if (const CommandSpec* row = FindCommand(command))
    {
        return CommandHelp(*row, width);
    }
    if (command.empty())
    {
        return OverviewHelp(width);
    }
    return "Usage: zebhost " + std::string(command) + " COMMAND ...\n\nCommands:\n" + CommandRows(command, width);
}

} // namespace zebhost
