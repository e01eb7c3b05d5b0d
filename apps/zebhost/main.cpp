#include "catalogue/PluginFinder.h"
#include "catalogue/SettingsJournal.h"
#include "catalogue/SettingsLock.h"
#include "cli/ArgumentParser.h"
#include "cli/Failure.h"
#include "cli/HelpText.h"
#include "cli/StartFolder.h"
#include "commands/Commands.h"
#include "filter/CrashGuard.h"
#include "filter/ThrowGuard.h"
#include "output/Tracing.h"
#include "scan/ScanWorker.h"

#include <module/Module.h>

#include <algorithm>
#include <array>
#include <exception>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>

namespace zebhost
{

namespace
{

using CommandFunction = ExitCode (*)(CommandContext&);

constexpr std::array<std::pair<std::string_view, CommandFunction>, 13> kCommands = {{{"scan", RunScan},
                                                                                     {"list", RunList},
                                                                                     {"info", RunInfo},
                                                                                     {"params", RunParams},
                                                                                     {"render", RunRender},
                                                                                     {"preset save", RunPresetSave},
                                                                                     {"preset load", RunPresetLoad},
                                                                                     {"preset list", RunPresetList},
                                                                                     {"edit", RunEdit},
                                                                                     {"block", RunBlock},
                                                                                     {"unblock", RunUnblock},
                                                                                     {"blocks", RunBlocks},
                                                                                     {"console", RunConsole}}};

bool ChangesSettings(const Arguments& arguments)
{
    return arguments.command == "block" || arguments.command == "unblock" ||
           (arguments.command == "scan" && !arguments.Has("dry-run"));
}

// A command that changes nothing still clears up behind a scan that was killed, unless it may not, or another program
// is at work: what that scan has found out counts in any case.
void LoadToRead(const SettingsFolder& folder, Catalogue& catalogue)
{
    const std::unique_ptr<SettingsLock> lock =
        SettingsJournal(folder.Journal()).Exists() ? SettingsLock::IfFree(folder.Path()) : nullptr;
    catalogue.Load();
    try
    {
        if (lock)
        {
            catalogue.SaveNoted();
        }
    }
    catch (const Failure&)
    {
        // Whoever changes the settings next is told.
    }
}

ExitCode RunWithLibrary(const Arguments& arguments, Console& console)
{
    const auto command = std::find_if(kCommands.begin(), kCommands.end(),
                                      [&arguments](const auto& each) { return each.first == arguments.command; });
    if (command == kCommands.end())
    {
        throw Failure(ExitCode::Usage, "there is no command " + arguments.command + ": see 'zebhost --help'");
    }
    StartTracing(arguments.All("trace"));
    zebaudiofilterhost::Initialize();
    const SettingsFolder folder(arguments.Text("settings"));
    // Before the files are read: what another program saved after that would be lost with the next save of this one.
    std::optional<SettingsLock> lock;
    if (ChangesSettings(arguments))
    {
        lock.emplace(folder.Path());
    }
    Catalogue catalogue(folder, console);
    if (lock)
    {
        catalogue.Load();
        catalogue.SaveNoted();
    }
    else
    {
        LoadToRead(folder, catalogue);
    }
    UseStandardPlaces();
    CommandContext context{arguments, console, catalogue};
    const ExitCode code = command->second(context);
    zebaudiofilterhost::Terminate();
    return code;
}

ExitCode Run(const Arguments& arguments, Console& console)
{
    if (arguments.Has("help"))
    {
        console.Print(HelpFor(arguments.command, console.OutputWidth()));
        return ExitCode::Done;
    }
    if (arguments.Has("version"))
    {
        console.Print("zebhost " ZEBHOST_VERSION "\n");
        return ExitCode::Done;
    }
    if (arguments.command == "completion")
    {
        return RunCompletion(arguments, console);
    }
    return arguments.command == "man" ? RunMan(arguments, console) : RunWithLibrary(arguments, console);
}

ExitCode Report(const Failure& failure, const Arguments& arguments, bool json, Console& console)
{
    if (json && !console.HasPrinted())
    {
        console.Print(ToText(FailureDocument(arguments.command, failure)));
    }
    for (const std::string& detail : failure.Details())
    {
        console.Warn("  " + detail);
    }
    console.Warn(std::string("zebhost: ") + failure.what());
    return failure.Code();
}

// Tells of the plug-in through whose guard an exception came, if it came through one.
Failure BlamedOr(const std::string& error, Failure otherwise)
{
    const std::string sentence = ThrowGuard::Sentence(error);
    return sentence.empty() ? std::move(otherwise) : Failure(ExitCode::JobFailed, sentence);
}

// Of what is being handled and is no Failure: a plug-in's if it came through its guard, or else of a library of ours.
Failure Unforeseen()
{
    try
    {
        throw;
    }
    catch (const std::filesystem::filesystem_error& error)
    {
        const std::string what = error.what();
        return BlamedOr(what, Failure(ExitCode::FileTrouble, what + ": make it readable and writable"));
    }
    catch (const std::exception& error)
    {
        const std::string what = error.what();
        return BlamedOr(what, Failure(ExitCode::JobFailed, "something unforeseen went wrong: " + what));
    }
    catch (...)
    {
        return BlamedOr({},
                        Failure(ExitCode::JobFailed, "a plug-in threw something that tells nothing: ask its maker"));
    }
}

// Whatever goes wrong ends with a sentence and a code.
ExitCode Guarded(int argc, const char* const* argv, Console& console)
{
    Arguments arguments;
    bool json = std::find(argv, argv + argc, std::string_view("--json")) != argv + argc;
    try
    {
        arguments = ParseArguments(argc, argv);
        json = arguments.Has("json");
        console.SetQuiet(arguments.Has("quiet"));
        if (json)
        {
            CrashGuard::WriteDocuments(arguments.command, console.OutputDescriptor());
        }
        return Run(arguments, console);
    }
    catch (const Failure& failure)
    {
        return Report(failure, arguments, json, console);
    }
    catch (...)
    {
        return Report(Unforeseen(), arguments, json, console);
    }
}

} // namespace

} // namespace zebhost

int main(int argc, char** argv)
{
    if (zebhost::IsWorkerCommandLine(argc, argv))
    {
        zebhost::RunScanWorker(argc, argv);
    }
    zebhost::startfolder::Remember();
    zebhost::Console console;
    zebhost::ExitCode code = zebhost::Guarded(argc, argv, console);
    if (!console.Flush() && code == zebhost::ExitCode::Done)
    {
        console.Warn("zebhost: standard output could not be written to the end: make room, or read it to the end");
        code = zebhost::ExitCode::FileTrouble;
    }
    zebhost::CrashGuard::ExpectEnd(static_cast<int>(code));
    return static_cast<int>(code);
}
