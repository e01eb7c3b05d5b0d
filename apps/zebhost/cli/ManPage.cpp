#include "cli/ManPage.h"

#include "cli/CommandTable.h"
#include "cli/HelpText.h"
#include "output/Strings.h"

namespace zebhost
{

namespace
{

// Roff reads a backslash anywhere, a hyphen as a typographic one, and a dot or quote at the head of a line.
std::string Escaped(std::string_view text)
{
    std::string result;
    for (const char letter : text)
    {
        if (letter == '\\')
        {
            result += "\\e";
        }
        else if (letter == '-')
        {
            result += "\\-";
        }
        else
        {
            result += letter;
        }
    }
    const bool isRequest = !result.empty() && (result.front() == '.' || result.front() == '\'');
    return isRequest ? "\\&" + result : result;
}

std::string Entry(std::string_view head, std::string_view text)
{
    return ".TP\n\\fB" + Escaped(head) + "\\fR\n" + Escaped(text) + "\n";
}

std::string Options(const std::vector<OptionSpec>& options)
{
    std::string text;
    for (const OptionSpec& option : options)
    {
        std::string help(option.help);
        if (!option.choices.empty())
        {
            help += ": " + Joined({option.choices.begin(), option.choices.end()}, ", ");
        }
        text += Entry(OptionSignature(option), help);
    }
    return text;
}

std::string Examples(const CommandSpec& command)
{
    std::string text;
    for (const ExampleSpec& example : command.examples)
    {
        text += ".PP\n.EX\n" + Escaped(example.line) + "\n.EE\n" + Escaped(example.meaning) + "\n";
    }
    return text;
}

std::string Section(const CommandSpec& command)
{
    std::string text = ".SS " + Escaped(UsageLine(command)) + "\n" + Escaped(command.summary) + "\n";
    if (!command.description.empty())
    {
        text += ".PP\n" + Escaped(command.description) + "\n";
    }
    for (const OperandSpec& operand : command.operands)
    {
        text += Entry(operand.name, operand.help);
    }
    return text + Options(command.options) + Examples(command);
}

std::string ExitCodes()
{
    return Entry("0", "done") + Entry("1", "the job failed") + Entry("2", "the command line is wrong") +
           Entry("3", "not found, or ambiguous") + Entry("4", "a plug-in could not be loaded") +
           Entry("5", "a plug-in crashed or did not answer in time") + Entry("6", "the plug-in is blocked") +
           Entry("7", "a file exists already, or cannot be read or written");
}

std::string Files()
{
    return Entry("$XDG_CONFIG_HOME/zebaudiofilterhost/",
                 "the preference folder, ~/.config/zebaudiofilterhost if the variable is not set; --settings names "
                 "another") +
           Entry("AudioPluginManagerSettings.xml", "the catalogue") +
           Entry("DynamicAudioPlugInBlacklist.xml", "blocked plug-ins") +
           Entry("DynamicAudioPlugInBlacklist.reasons.json", "why and since when they are blocked") +
           Entry("PermanentAudioPlugInBlacklist.xml", "plug-ins that are never used, by file name; not written") +
           Entry("Presets/", "the preset store");
}

std::string Environment()
{
    return Entry("VST3_PATH",
                 "folders to search for VST 3 plug-ins instead of the standard ones, separated by colons") +
           Entry("VST_PATH", "the same for VST 2 plug-ins") +
           Entry("NO_COLOR", "when set and not empty, output has no colours") +
           Entry("DISPLAY", "the X11 display that edit opens its window on");
}

} // namespace

std::string ManPage(const std::string& version)
{
    std::string page = ".TH ZEBHOST 1 \"\" \"zebhost " + Escaped(version) + "\" \"User Commands\"\n";
    page += ".SH NAME\nzebhost \\- find audio plug\\-ins and run sound files through them\n";
    page += ".SH SYNOPSIS\n.B zebhost\n.I COMMAND\n[\\fIOPTIONS\\fR] ...\n";
    page +=
        ".SH DESCRIPTION\nData goes to standard output, all else to standard error, whose last line says what went "
        "wrong, with which file, and what to do.\n";
    page += ".SH COMMANDS\n";
    for (const CommandSpec& command : CommandTable())
    {
        page += Section(command);
    }
    page += ".SH OPTIONS OF EVERY COMMAND\n" + Options(CommonOptions());
    page += ".SH EXIT STATUS\n" + ExitCodes() + ".SH FILES\n" + Files() + ".SH ENVIRONMENT\n" + Environment();
    return page;
}

} // namespace zebhost
