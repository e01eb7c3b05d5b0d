#include "cli/ShellCompletion.h"

#include "cli/CommandTable.h"
#include "output/Strings.h"

#include <algorithm>
#include <set>

namespace zebhost
{

namespace
{

std::vector<std::string> FirstWords()
{
    std::vector<std::string> words;
    for (const CommandSpec& command : CommandTable())
    {
        const std::string word = Split(command.name, ' ').front();
        if (std::find(words.begin(), words.end(), word) == words.end())
        {
            words.push_back(word);
        }
    }
    return words;
}

std::vector<std::string> SecondWords(std::string_view firstWord)
{
    std::vector<std::string> words;
    for (const CommandSpec& command : CommandTable())
    {
        const std::vector<std::string> parts = Split(command.name, ' ');
        if (parts.size() == 2 && parts.front() == firstWord)
        {
            words.push_back(parts.back());
        }
    }
    return words;
}

bool IsSecondWordNeeded(std::string_view firstWord)
{
    return !SecondWords(firstWord).empty();
}

std::string SingleQuoted(std::string_view text)
{
    std::string result = "'";
    for (const char letter : text)
    {
        result += letter == '\'' ? std::string("'\\''") : std::string(1, letter);
    }
    return result + "'";
}

std::string DashedNames(const std::vector<OptionSpec>& options)
{
    std::vector<std::string> names;
    for (const OptionSpec& option : options)
    {
        names.push_back("--" + std::string(option.name));
    }
    return Joined(names, " ");
}

std::string OptionWords(const CommandSpec& command)
{
    const std::string own = DashedNames(command.options);
    return own + (own.empty() ? "" : " ") + DashedNames(CommonOptions()) + " --help";
}

std::string BashValues(Values values, const std::vector<std::string_view>& choices)
{
    switch (values)
    {
    case Values::Choice:
        return "COMPREPLY=($(compgen -W '" + Joined({choices.begin(), choices.end()}, " ") + "' -- \"$cur\"))";
    case Values::Filter:
    case Values::Plugin:
        return "_zebhost_filters";
    case Values::ConsoleCommand:
        return "COMPREPLY=($(compgen -W \"$(zebhost console --names --quiet 2>/dev/null)\" -- \"$cur\"))";
    case Values::File:
        return "compopt -o filenames; COMPREPLY=($(compgen -f -- \"$cur\"))";
    case Values::Folder:
        return "compopt -o filenames; COMPREPLY=($(compgen -d -- \"$cur\"))";
    case Values::None:
    case Values::Text:
    case Values::Number:
        break;
    }
    return "COMPREPLY=()";
}

void AddBashValues(std::string& script, const std::vector<OptionSpec>& options, const std::string& command)
{
    for (const OptionSpec& option : options)
    {
        if (option.values != Values::None)
        {
            script += "        '" + command + ":--" + std::string(option.name) + "') " +
                      BashValues(option.values, option.choices) + "; return ;;\n";
        }
    }
}

// The first operand is completed by its kind, every later one by the kind of the last.
void AddBashOperands(std::string& script, const CommandSpec& command)
{
    if (command.operands.empty())
    {
        return;
    }
    const OperandSpec& first = command.operands.front();
    const OperandSpec& last = command.operands.back();
    script += "        '" + std::string(command.name) + "') if (( operands == 0 )); then " +
              BashValues(first.values, first.choices) + "; else " + BashValues(last.values, last.choices) +
              "; fi ;;\n";
}

std::string TwoWordPattern()
{
    std::vector<std::string> patterns;
    for (const std::string& word : FirstWords())
    {
        if (IsSecondWordNeeded(word))
        {
            patterns.push_back(word);
        }
    }
    return Joined(patterns, "|");
}

constexpr std::string_view kBashHead = R"(# bash completion for zebhost
_zebhost_filters() {
    local IFS=$'\n'
    compopt -o filenames
    COMPREPLY=($(compgen -f -- "$cur"))
    local name
    while read -r name; do
        [[ $name == "$cur"* ]] && COMPREPLY+=("$name")
    done < <(zebhost list --names --quiet 2>/dev/null)
}
_zebhost() {
    local cur=${COMP_WORDS[COMP_CWORD]} prev=${COMP_WORDS[COMP_CWORD-1]} command= operands=0 word i skip=0
    COMPREPLY=()
    for (( i = 1; i < COMP_CWORD; i++ )); do
        word=${COMP_WORDS[i]}
        if (( skip )); then skip=0; continue; fi
        case $word in
        )";

constexpr std::string_view kBashMiddle = R"() skip=1 ;;
        -*) ;;
        *) if [[ -z $command ]]; then command=$word
           elif [[ $command =~ ^(@TWO@)$ ]]; then command="$command $word"
           else (( operands++ )); fi ;;
        esac
    done
    case "$command:$prev" in
)";

std::string Replaced(std::string text, std::string_view what, std::string_view with)
{
    const std::size_t at = text.find(what);
    return at == std::string::npos ? text : text.replace(at, what.size(), with);
}

std::string ValueOptionPattern()
{
    std::set<std::string> names;
    const auto add = [&names](const std::vector<OptionSpec>& options)
    {
        for (const OptionSpec& option : options)
        {
            if (option.values != Values::None)
            {
                names.insert("--" + std::string(option.name));
            }
        }
    };
    add(CommonOptions());
    for (const CommandSpec& command : CommandTable())
    {
        add(command.options);
    }
    return Joined({names.begin(), names.end()}, "|");
}

std::string BashCompletion()
{
    std::string script(kBashHead);
    script += ValueOptionPattern();
    script += Replaced(std::string(kBashMiddle), "@TWO@", TwoWordPattern());
    for (const CommandSpec& command : CommandTable())
    {
        AddBashValues(script, command.options, std::string(command.name));
        AddBashValues(script, CommonOptions(), std::string(command.name));
    }
    script += "    esac\n    if [[ $cur == -* ]]; then\n        case $command in\n";
    for (const CommandSpec& command : CommandTable())
    {
        script += "        '" + std::string(command.name) + "') COMPREPLY=($(compgen -W '" + OptionWords(command) +
                  "' -- \"$cur\")) ;;\n";
    }
    script += "        *) COMPREPLY=($(compgen -W '" + DashedNames(CommonOptions()) +
              " --help --version' -- \"$cur\")) ;;\n        esac\n        return\n    fi\n    case $command in\n";
    script += "        '') COMPREPLY=($(compgen -W '" + Joined(FirstWords(), " ") + "' -- \"$cur\")) ;;\n";
    for (const std::string& word : FirstWords())
    {
        if (IsSecondWordNeeded(word))
        {
            script += "        '" + word + "') COMPREPLY=($(compgen -W '" + Joined(SecondWords(word), " ") +
                      "' -- \"$cur\")) ;;\n";
        }
    }
    for (const CommandSpec& command : CommandTable())
    {
        AddBashOperands(script, command);
    }
    return script + "    esac\n}\ncomplete -F _zebhost zebhost\n";
}

// zsh runs bash's completion functions when told to.
std::string ZshCompletion()
{
    return "#compdef zebhost\nautoload -U +X bashcompinit && bashcompinit\n" + BashCompletion();
}

std::string FishCondition(std::string_view command)
{
    std::string condition;
    for (const std::string& word : Split(command, ' '))
    {
        condition += std::string(condition.empty() ? "" : "; and ") + "__fish_seen_subcommand_from " + word;
    }
    return condition;
}

std::string FishOption(const OptionSpec& option, const std::string& condition)
{
    std::string line = "complete -c zebhost" + (condition.empty() ? "" : " -n " + SingleQuoted(condition)) + " -l " +
                       std::string(option.name) + " -d " + SingleQuoted(option.help);
    if (option.values == Values::Choice)
    {
        line += " -x -a " + SingleQuoted(Joined({option.choices.begin(), option.choices.end()}, " "));
    }
    else if (option.values == Values::File || option.values == Values::Folder)
    {
        line += " -r -F";
    }
    else if (option.values != Values::None)
    {
        line += " -x";
    }
    return line + "\n";
}

void AddFishCommand(std::string& script, const CommandSpec& command)
{
    const std::vector<std::string> words = Split(command.name, ' ');
    const std::string seen = words.size() == 1
                                 ? "__fish_use_subcommand"
                                 : FishCondition(words.front()) + "; and not __fish_seen_subcommand_from " +
                                       Joined(SecondWords(words.front()), " ");
    script += "complete -c zebhost -f -n " + SingleQuoted(seen) + " -a " + words.back() + " -d " +
              SingleQuoted(command.summary) + "\n";
    const std::string condition = FishCondition(command.name);
    for (const OptionSpec& option : command.options)
    {
        script += FishOption(option, condition);
    }
    for (const OperandSpec& operand : command.operands)
    {
        if (operand.values == Values::Filter || operand.values == Values::Plugin)
        {
            script += "complete -c zebhost -n " + SingleQuoted(condition) +
                      " -a '(zebhost list --names --quiet 2>/dev/null)'\n";
        }
        else if (operand.values == Values::ConsoleCommand)
        {
            script += "complete -c zebhost -f -n " + SingleQuoted(condition) +
                      " -a '(zebhost console --names --quiet 2>/dev/null)'\n";
        }
        else if (operand.values == Values::Choice)
        {
            script += "complete -c zebhost -f -n " + SingleQuoted(condition) + " -a " +
                      SingleQuoted(Joined({operand.choices.begin(), operand.choices.end()}, " ")) + "\n";
        }
    }
}

std::string FishCompletion()
{
    std::string script = "# fish completion for zebhost\n";
    for (const std::string& word : FirstWords())
    {
        if (IsSecondWordNeeded(word))
        {
            script += "complete -c zebhost -f -n __fish_use_subcommand -a " + word + "\n";
        }
    }
    for (const CommandSpec& command : CommandTable())
    {
        AddFishCommand(script, command);
    }
    for (const OptionSpec& option : CommonOptions())
    {
        script += FishOption(option, {});
    }
    return script;
}

} // namespace

std::string ShellCompletion(std::string_view shell)
{
    if (shell == "fish")
    {
        return FishCompletion();
    }
    return shell == "zsh" ? ZshCompletion() : BashCompletion();
}

} // namespace zebhost
