#include "cli/CommandTable.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

using testing::HasSubstr;
using testing::StartsWith;

std::vector<std::string> Words(std::string_view text)
{
    std::vector<std::string> words;
    std::istringstream stream{std::string(text)};
    for (std::string word; stream >> word;)
    {
        words.push_back(word);
    }
    return words;
}

class CommandLineTest : public ZebhostTest
{
};

TEST_F(CommandLineTest, WrongUseEndsWithCodeTwoAndTellsWhereHelpIs)
{
    const std::vector<std::vector<std::string>> lines = {
        {},
        {"frob"},
        {"preset"},
        {"preset", "frob"},
        {"info"},
        {"list", "--frob"},
        {"list", "one", "two"},
        {"render", "Gain", "only-one.wav"},
        {"render", "Gain", "a.wav", "b.wav", "c.wav"},
        {"render", "Gain", "a.wav", "b.wav", "--block", "0"},
        {"render", "Gain", "a.wav", "b.wav", "--block", "1.5"},
        {"render", "Gain", "a.wav", "b.wav", "--block", "many"},
        {"render", "Gain", "a.wav", "b.wav", "--tail", "soon"},
        {"render", "Gain", "a.wav", "b.wav", "--tail", "3dB"},
        {"render", "Gain", "a.wav", "b.wav", "--time-sig", "4"},
        {"render", "Gain", "a.wav", "b.wav", "--time-sig", "4/3"},
        {"render", "Gain", "a.wav", "b.wav", "--tempo", "nan"},
        {"render", "Gain", "a.wav", "b.wav", "--format", "12"},
        {"render", "Gain", "a.wav", "b.wav", "--block", "64", "--block", "128"},
        {"completion", "csh"},
        {"frob", "--help"},
        {"preset", "frob", "--help"},
    };
    for (const std::vector<std::string>& line : lines)
    {
        const RunResult result = Run(line);
        EXPECT_EQ(result.code, 2) << testing::PrintToString(line) << result.err;
        EXPECT_EQ(result.out, "") << testing::PrintToString(line);
        EXPECT_THAT(result.LastLine(), StartsWith("zebhost: ")) << testing::PrintToString(line);
    }
}

TEST_F(CommandLineTest, WhatIsWrongIsSaidInWordsOfItsOwn)
{
    const std::vector<std::pair<std::vector<std::string>, std::string>> lines = {
        {{"params", "Gain", "--set"}, "--set needs a value"},
        {{"list", "--trace"}, "--trace needs a value"},
        {{"render", "Gain", "a.wav", "b.wav", "--tempo", "90", "--tempo", "91"}, "--tempo is given 2 times"},
        {{"list", "--json=no"}, "--json takes no value"},
        {{"info", ""}, "FILTER is empty"},
        {{"params", ""}, "FILTER is empty"},
        {{"edit", ""}, "FILTER is empty"},
        {{"preset", "list", ""}, "FILTER is empty"},
        {{"preset", "save", "Gain", ""}, "PRESET is empty"},
        {{"block", ""}, "PLUGIN is empty"},
        {{"unblock", ""}, "PLUGIN is empty"},
        {{"scan", "folder", ""}, "PATH is empty"},
        {{"blocks", "--settings", ""}, "--settings is empty"},
        {{"render", "Gain", "a.wav", "b.wav", "--automation", ""}, "--automation is empty"},
        {{"render", "Gain", "a.wav", "b.wav", "--side-chain", ""}, "--side-chain is empty"},
        {{"render", "Gain", "a.wav", "b.wav", "--on", ""}, "--on is empty"},
    };
    for (const auto& [line, words] : lines)
    {
        const RunResult result = Run(line);
        EXPECT_EQ(result.code, 2) << words << result.err;
        EXPECT_THAT(result.LastLine(), StartsWith("zebhost: " + words)) << testing::PrintToString(line);
    }
}

TEST_F(CommandLineTest, EveryCommandExplainsItselfWithTwoExamplesThatAreItsOwn)
{
    for (const zebhost::CommandSpec& command : zebhost::CommandTable())
    {
        std::vector<std::string> line = Words(command.name);
        line.emplace_back("--help");
        const RunResult result = Succeed(line);
        EXPECT_THAT(result.out, HasSubstr("Usage: zebhost " + std::string(command.name))) << command.name;
        EXPECT_GE(command.examples.size(), 2U) << command.name;
        for (const zebhost::ExampleSpec& example : command.examples)
        {
            EXPECT_THAT(result.out, HasSubstr(std::string(example.line)));
            EXPECT_THAT(std::string(example.line), HasSubstr("zebhost " + std::string(command.name)));
        }
        for (const zebhost::OptionSpec& option : command.options)
        {
            EXPECT_THAT(result.out, HasSubstr("--" + std::string(option.name))) << command.name;
        }
    }
}

TEST_F(CommandLineTest, CommonOptionsStandBeforeOrBehindTheCommand)
{
    for (const std::vector<std::string>& line :
         {std::vector<std::string>{"--json", "blocks"}, std::vector<std::string>{"blocks", "--json"}})
    {
        EXPECT_EQ(Succeed(line).Json().at("command"), "blocks");
    }
}

TEST_F(CommandLineTest, NamesOfCommandsAreNoCommandsInThePlaceOfOperands)
{
    const RunResult result = Run({"info", "list"});
    EXPECT_EQ(result.code, 3) << result.err;
    EXPECT_THAT(result.LastLine(), HasSubstr("list"));
}

TEST_F(CommandLineTest, FailuresAreDocumentsTooWhenJsonIsAskedFor)
{
    const RunResult result = Run({"info", "Nothing", "--json"});
    EXPECT_EQ(result.code, 3);
    const nlohmann::json document = result.Json();
    EXPECT_EQ(document.at("schema"), 1);
    EXPECT_EQ(document.at("ok"), false);
    EXPECT_EQ(document.at("error").at("code"), 3);
    EXPECT_EQ(document.at("error").at("kind"), "not-found");
    EXPECT_EQ("zebhost: " + document.at("error").at("message").get<std::string>(), result.LastLine());
}

TEST_F(CommandLineTest, QuietLeavesTheDataAndTheLastWord)
{
    const RunResult scanned = Succeed({"scan", "--quiet"});
    EXPECT_EQ(scanned.err, "");
    EXPECT_NE(scanned.out, "");
    EXPECT_THAT(Run({"info", "Nothing", "--quiet"}).LastLine(), HasSubstr("Nothing"));
}

TEST_F(CommandLineTest, TraceLinesOfACategoryGoToStandardError)
{
    const RunResult result = Succeed({"scan", "--quiet", "--trace", "VST3PluginModule::Load"});
    EXPECT_THAT(result.err, HasSubstr("<VST3PluginModule::Load> <6> "));
    EXPECT_THAT(result.out, testing::Not(HasSubstr("<6>")));
}

TEST_F(CommandLineTest, OutputThatCannotBeWrittenIsToldOf)
{
    WriteText(Path("run.sh"), std::string("#!/bin/sh\n\"$@\" > /dev/full\n"));
    const RunResult result = RunProgram({"sh", Path("run.sh"), ZEBHOST_PROGRAM, "man"}, mVariables, mFolder);
    EXPECT_EQ(result.code, 7);
    EXPECT_THAT(result.LastLine(), HasSubstr("standard output"));
}

TEST_F(CommandLineTest, TheManualPageIsWellFormedAndNamesEveryOption)
{
    const RunResult page = Succeed({"man"});
    for (const zebhost::CommandSpec& command : zebhost::CommandTable())
    {
        EXPECT_THAT(page.out, HasSubstr(".SS zebhost " + std::string(command.name)));
    }
    if (RunProgram({"groff", "--version"}, mVariables, mFolder).code != 0)
    {
        GTEST_SKIP() << "groff is not installed: the page was not formatted";
    }
    WriteText(Path("zebhost.1"), page.out);
    const RunResult formatted =
        RunProgram({"groff", "-man", "-ww", "-Tutf8", Path("zebhost.1")}, mVariables, mFolder);
    EXPECT_EQ(formatted.code, 0);
    EXPECT_EQ(formatted.err, "");
    EXPECT_THAT(formatted.out, HasSubstr("--side-chain"));
}

TEST_F(CommandLineTest, BashCompletesCommandsOptionsAndFilters)
{
    Succeed({"scan", "--quiet"});
    WriteText(Path("zebhost.bash"), Succeed({"completion", "bash"}).out);
    WriteText(Path("try.bash"), R"(
compopt() { :; }
zebhost() { )" ZEBHOST_PROGRAM R"( --settings "$SETTINGS" "$@"; }
. "$1"; shift
COMP_WORDS=(zebhost "$@"); COMP_CWORD=$#
_zebhost
printf '%s\n' "${COMPREPLY[@]}"
)");
    mVariables["SETTINGS"] = Settings().string();
    const auto complete = [this](std::vector<std::string> words)
    {
        words.insert(words.begin(), {"bash", Path("try.bash"), Path("zebhost.bash")});
        const RunResult result = RunProgram(words, mVariables, mFolder);
        EXPECT_EQ(result.err, "");
        return result.out;
    };
    EXPECT_EQ(complete({"unb"}), "unblock\n");
    EXPECT_EQ(complete({"preset", "l"}), "load\nlist\n");
    EXPECT_EQ(complete({"render", "--side"}), "--side-chain\n");
    EXPECT_EQ(complete({"render", "--format", "fl"}), "float\n");
    for (const char* typed : {"Zeb Ga", "Zeb\\ Ga", "\"Zeb Ga", "'Zeb Ga"})
    {
        EXPECT_EQ(complete({"info", typed}), "Zeb Gain\n") << typed;
    }
    std::filesystem::create_directories(mFolder / "a folder");
    WriteText(Path("a [file].wav"), "");
    EXPECT_EQ(complete({"--settings", Path("a")}), Path("a folder") + "\n");
    EXPECT_EQ(complete({"list", "--settings", Path("a\\ f")}), Path("a folder") + "\n");
    EXPECT_EQ(complete({"render", "Zeb\\ Gain", "\"" + Path("a [")}), Path("a [file].wav") + "\n");
    EXPECT_EQ(complete({"unblock", ""}), "\n");
    Succeed({"block", "Zeb Gain"});
    EXPECT_EQ(complete({"unblock", ""}), "ZebGain.vst3\n");
    EXPECT_EQ(complete({"completion", "z"}), "zsh\n");
    EXPECT_EQ(complete({"console", "zeb"}), "zebaudiofilterhost.BuildPrivatePluginConfig\n");
}

// What the shell's own functions make of what they are given is the shell's.
TEST_F(CommandLineTest, ZshIsOfferedTheSame)
{
    if (RunProgram({"zsh", "-f", "-c", ":"}, mVariables, mFolder).code != 0)
    {
        GTEST_SKIP() << "zsh is not installed: its completion was not tried";
    }
    Succeed({"scan", "--quiet"});
    Succeed({"block", "Zeb Delay"});
    WriteText(Path("zebhost.zsh"), Succeed({"completion", "zsh"}).out);
    WriteText(Path("try.zsh"), R"(
compdef() { :; }
_files() { print -r -- files "$@"; }
compadd() { shift; print -rl -- "$@"; }
zebhost() { )" ZEBHOST_PROGRAM R"( --settings "$SETTINGS" "$@"; }
. "$1"; shift
words=(zebhost "$@"); CURRENT=$#words; PREFIX=$words[-1]
_zebhost
)");
    mVariables["SETTINGS"] = Settings().string();
    const auto complete = [this](std::vector<std::string> words)
    {
        words.insert(words.begin(), {"zsh", "-f", Path("try.zsh"), Path("zebhost.zsh")});
        const RunResult result = RunProgram(words, mVariables, mFolder);
        EXPECT_EQ(result.err, "");
        return result.out;
    };
    EXPECT_THAT(complete({"unb"}), HasSubstr("\nunblock\n"));
    EXPECT_EQ(complete({"preset", ""}), "save\nload\nlist\n");
    EXPECT_THAT(complete({"info", ""}), testing::AllOf(StartsWith("files\n"), HasSubstr("\nZeb Gain\n")));
    EXPECT_EQ(complete({"unblock", ""}), "ZebDelay.vst3\n");
    EXPECT_EQ(complete({"--settings", ""}), "files -/\n");
    EXPECT_EQ(complete({"preset", "list", "--settings", ""}), "files -/\n");
    EXPECT_THAT(complete({"render", "-"}), HasSubstr("\n--side-chain\n"));
}

TEST_F(CommandLineTest, FishOffersFiltersAndWhatIsBlocked)
{
    if (RunProgram({"fish", "--no-config", "-c", ":"}, mVariables, mFolder).code != 0)
    {
        GTEST_SKIP() << "fish is not installed: its completion was not tried";
    }
    Succeed({"scan", "--quiet"});
    Succeed({"block", "Zeb Delay"});
    WriteText(Path("try.fish"), "function zebhost; " ZEBHOST_PROGRAM " --settings $SETTINGS $argv; end\n" +
                                    Succeed({"completion", "fish"}).out + "complete -C $argv[1]\n");
    mVariables["SETTINGS"] = Settings().string();
    const auto complete = [this](const std::string& line)
    {
        const RunResult result = RunProgram({"fish", "--no-config", Path("try.fish"), line}, mVariables, mFolder);
        EXPECT_EQ(result.err, "");
        return result.out;
    };
    EXPECT_EQ(complete("zebhost unblock "), "ZebDelay.vst3\n");
    EXPECT_THAT(complete("zebhost info Zeb"), HasSubstr("Zeb Gain\n"));
    EXPECT_THAT(complete("zebhost unb"), StartsWith("unblock\t"));
}

} // namespace

} // namespace zebtest
