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

// The call that offers what can stand there; each shell has its own functions of these names.
std::string OfferingOf(Values values, const std::vector<std::string_view>& choices)
{
    switch (values)
    {
    case Values::Choice:
        return "_zebhost_words " + Joined({choices.begin(), choices.end()}, " ");
    case Values::Filter:
    case Values::Plugin:
        return "_zebhost_files; _zebhost_lines zebhost list --names --quiet";
    case Values::Blocked:
        return "_zebhost_lines zebhost blocks --names --quiet";
    case Values::ConsoleCommand:
        return "_zebhost_lines zebhost console --names --quiet";
    case Values::File:
        return "_zebhost_files";
    case Values::Folder:
        return "_zebhost_folders";
    case Values::None:
    case Values::Text:
    case Values::Number:
        break;
    }
    return ":";
}

// `command` is a pattern.
void AddOptionValues(std::string& script, const std::vector<OptionSpec>& options, const std::string& command)
{
    for (const OptionSpec& option : options)
    {
        if (option.values != Values::None)
        {
            script += "        " + command + ":--" + std::string(option.name) + ") " +
                      OfferingOf(option.values, option.choices) + "; return ;;\n";
        }
    }
}

// The first operand is completed by its kind, every later one by the kind of the last.
void AddOperandValues(std::string& script, const CommandSpec& command)
{
    if (command.operands.empty())
    {
        return;
    }
    const OperandSpec& first = command.operands.front();
    const OperandSpec& last = command.operands.back();
    script += "        '" + std::string(command.name) + "') if (( operands == 0 )); then " +
              OfferingOf(first.values, first.choices) + "; else " + OfferingOf(last.values, last.choices) +
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

// What was typed may be quoted; bash quotes what it takes over, if it counts as the name of a file.
constexpr std::string_view kBashHead = R"(# bash completion for zebhost
_zebhost_add() {
    local line
    while IFS= read -r line; do
        [[ $line == "$typed"* ]] && COMPREPLY+=("$line")
    done
}
_zebhost_words() { _zebhost_add < <(printf '%s\n' "$@"); }
_zebhost_lines() { compopt -o filenames; _zebhost_add < <("$@" 2>/dev/null); }
_zebhost_files() { compopt -o filenames; _zebhost_add < <(compgen -f -- "$typed"); }
_zebhost_folders() { compopt -o filenames; _zebhost_add < <(compgen -d -- "$typed"); }
_zebhost() {
    local cur=${COMP_WORDS[COMP_CWORD]} prev=${COMP_WORDS[COMP_CWORD-1]} typed
    COMPREPLY=()
    case $cur in
        [\"\']*) typed=${cur:1} ;;
        *) typed=${cur//\\/} ;;
    esac
    _zebhost_offer "${COMP_WORDS[@]:1:COMP_CWORD-1}"
}
)";

constexpr std::string_view kBashFoot = "complete -F _zebhost zebhost\n";

constexpr std::string_view kZshHead = R"(#compdef zebhost
_zebhost_words() { compadd -- "$@" }
_zebhost_lines() {
    local -a lines=("${(@f)$("$@" 2>/dev/null)}")
    compadd -- "${(@)lines:#}"
}
_zebhost_files() { _files }
_zebhost_folders() { _files -/ }
_zebhost() {
    local cur=$PREFIX prev=${words[CURRENT-1]}
    _zebhost_offer "${(@)words[2,CURRENT-1]}"
}
)";

// As a file in $fpath it is called at once; to be sourced it needs zsh's completion at work.
constexpr std::string_view kZshFoot = R"(if [[ ${funcstack[1]} == _zebhost ]]; then
    _zebhost "$@"
else
    (( $+functions[compdef] )) || { autoload -Uz compinit && compinit; }
    compdef _zebhost zebhost
fi
)";

constexpr std::string_view kOfferHead = R"(_zebhost_offer() {
    local command= operands=0 word skip=0
    for word in "$@"; do
        if (( skip )); then skip=0; continue; fi
        case $word in
        )";

constexpr std::string_view kOfferMiddle = R"() skip=1 ;;
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

// In words that bash and zsh both understand, from the words before the one at hand.
std::string OfferFunction()
{
    std::string script(kOfferHead);
    script += ValueOptionPattern();
    script += Replaced(std::string(kOfferMiddle), "@TWO@", TwoWordPattern());
    for (const CommandSpec& command : CommandTable())
    {
        AddOptionValues(script, command.options, "'" + std::string(command.name) + "'");
    }
    AddOptionValues(script, CommonOptions(), "*");
    script += "    esac\n    if [[ $cur == -* ]]; then\n        case $command in\n";
    for (const CommandSpec& command : CommandTable())
    {
        script += "        '" + std::string(command.name) + "') _zebhost_words " + OptionWords(command) + " ;;\n";
    }
    script += "        *) _zebhost_words " + DashedNames(CommonOptions()) +
              " --help --version ;;\n        esac\n        return\n    fi\n    case $command in\n";
    script += "        '') _zebhost_words " + Joined(FirstWords(), " ") + " ;;\n";
    for (const std::string& word : FirstWords())
    {
        if (IsSecondWordNeeded(word))
        {
            script += "        '" + word + "') _zebhost_words " + Joined(SecondWords(word), " ") + " ;;\n";
        }
    }
    for (const CommandSpec& command : CommandTable())
    {
        AddOperandValues(script, command);
    }
    return script + "    esac\n}\n";
}

std::string BashCompletion()
{
    return std::string(kBashHead) + OfferFunction() + std::string(kBashFoot);
}

std::string ZshCompletion()
{
    return std::string(kZshHead) + OfferFunction() + std::string(kZshFoot);
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
        else if (operand.values == Values::ConsoleCommand || operand.values == Values::Blocked)
        {
            const std::string lister = operand.values == Values::Blocked ? "blocks" : "console";
            script += "complete -c zebhost -f -n " + SingleQuoted(condition) + " -a '(zebhost " + lister +
                      " --names --quiet 2>/dev/null)'\n";
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
