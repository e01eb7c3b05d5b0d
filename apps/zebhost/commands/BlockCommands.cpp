#include "catalogue/FilterSelector.h"
#include "catalogue/PluginFinder.h"
#include "cli/Failure.h"
#include "commands/Commands.h"
#include "output/Strings.h"
#include "output/TextTable.h"

#include <host/BannedPluginManager.h>

#include <filesystem>
#include <map>
#include <vector>

namespace zebhost
{

using zebaudiofilterhost::BannedPluginManager;
using zebaudiofilterhost::PluginLocator;

namespace
{

std::vector<PluginLocator> Blocked()
{
    const BannedPluginManager& manager = BannedPluginManager::GetInstance();
    return {manager.BannedBegin(), manager.BannedEnd()};
}

// The full name of one that is no file, or what stands behind its maker.
bool IsPlace(const PluginLocator& locator, const std::string& text)
{
    const std::string place = PlaceOf(locator);
    const std::size_t colon = place.find(':');
    return place == text ||
           (place != PathOf(locator) && colon != std::string::npos && Trimmed(place.substr(colon + 1)) == text);
}

std::vector<PluginLocator> BlockedAt(const std::string& path)
{
    std::vector<PluginLocator> blocked;
    for (const PluginLocator& locator : PluginsAt(path))
    {
        if (BannedPluginManager::GetInstance().IsPluginBanned(locator))
        {
            blocked.push_back(locator);
        }
    }
    return blocked;
}

// A blocked plug-in may be gone from disk and catalogue, so its file name alone will do.
std::vector<PluginLocator> BlockedPlugins(const CommandContext& context, const std::string& text)
{
    if (std::vector<PluginLocator> there = BlockedAt(text); !there.empty())
    {
        return there;
    }
    std::vector<PluginLocator> fitting;
    for (const PluginLocator& locator : Blocked())
    {
        const std::filesystem::path path = PathOf(locator);
        if (path == text || path.filename() == text || path.stem() == text || SelectorOf(locator) == text ||
            IsPlace(locator, text))
        {
            fitting.push_back(locator);
        }
    }
    if (fitting.size() > 1)
    {
        throw Failure(ExitCode::NotFound,
                      text + " fits several blocked plug-ins: give a path as 'zebhost blocks' shows it");
    }
    if (fitting.empty())
    {
        fitting = FilterSelector(context.catalogue).SelectPlugins(text);
        if (!BannedPluginManager::GetInstance().IsPluginBanned(fitting.front()))
        {
            throw Failure(ExitCode::NotFound,
                          PlaceOf(fitting.front()) + " is not blocked: 'zebhost blocks' shows what is");
        }
    }
    return fitting;
}

// The JSON names the first at its top, and all in a list.
void Tell(const CommandContext& context, const std::vector<PluginLocator>& locators, const std::string& what)
{
    if (context.WantsJson())
    {
        Json document = context.NewDocument();
        document["path"] = PathOf(locators.front());
        document["place"] = PlaceOf(locators.front());
        document["plugins"] = Json::array();
        for (const PluginLocator& locator : locators)
        {
            document["plugins"].push_back(Json{{"path", PathOf(locator)}, {"place", PlaceOf(locator)}});
        }
        context.Print(document);
    }
    for (const PluginLocator& locator : locators)
    {
        context.console.Remark("zebhost: " + PlaceOf(locator) + what);
    }
}

// A scan without paths may not find the units of a bundle that lies elsewhere.
std::string WhatTriesIt(const PluginLocator& locator, const std::string& text)
{
    if (!IsInstalled(locator))
    {
        return "; there is nothing at its place now";
    }
    const bool isUnitOfBundle =
        locator.GetTechnologyType() == zebaudiofilterhost::kTechnologyAudioUnit && IsBundlePath(text);
    return isUnitOfBundle ? "; 'zebhost scan " + ShellWord(text) + "' tries it"
                          : "; the next 'zebhost scan' tries it";
}

// Of several with one file name, the paths.
void PrintNames(const CommandContext& context)
{
    std::map<std::string, std::vector<std::string>> places;
    for (const PluginLocator& locator : Blocked())
    {
        const std::string place = PlaceOf(locator);
        places[place == PathOf(locator) ? std::filesystem::path(place).filename().string() : place].push_back(place);
    }
    for (const auto& [name, all] : places)
    {
        context.console.Print((all.size() == 1 ? name : Joined(all, "\n")) + "\n");
    }
}

} // namespace

ExitCode RunBlock(CommandContext& context)
{
    const std::vector<PluginLocator> locators =
        FilterSelector(context.catalogue).SelectPlugins(context.arguments.Text("PLUGIN"));
    BlockReason why;
    why.reason = context.arguments.Text("reason", "blocked by hand");
    why.since = TimeOfNow();
    why.isByHand = true;
    for (const PluginLocator& locator : locators)
    {
        if (!IsInstalled(locator))
        {
            context.console.Remark("zebhost: there is nothing at " + PlaceOf(locator) + " now");
        }
        context.catalogue.Block(locator, why);
    }
    Tell(context, locators, " is blocked; 'zebhost unblock' lets it be used again");
    return ExitCode::Done;
}

ExitCode RunUnblock(CommandContext& context)
{
    const std::string text = context.arguments.Text("PLUGIN");
    const std::vector<PluginLocator> locators = BlockedPlugins(context, text);
    for (const PluginLocator& locator : locators)
    {
        context.catalogue.Unblock(locator);
        context.catalogue.Stamps().MarkToBeTried(locator);
    }
    context.catalogue.SaveStamps(LocatorTable::Saving::Flushed);
    Tell(context, locators, " is not blocked any more" + WhatTriesIt(locators.front(), text));
    return ExitCode::Done;
}

ExitCode RunBlocks(CommandContext& context)
{
    TextTable table({"PATH", "SINCE", "REASON"});
    Json document = context.NewDocument();
    document["blocked"] = Json::array();
    for (const PluginLocator& locator : Blocked())
    {
        const BlockReason why = context.catalogue.Reasons().Get(locator);
        table.AddRow({PlaceOf(locator), why.since, why.reason});
        document["blocked"].push_back(Json{
            {"path", PathOf(locator)}, {"place", PlaceOf(locator)}, {"since", why.since}, {"reason", why.reason}});
    }
    if (context.WantsJson())
    {
        context.Print(document);
    }
    else if (context.arguments.Has("names"))
    {
        PrintNames(context);
    }
    else if (table.IsEmpty())
    {
        context.console.Remark("zebhost: no plug-in is blocked");
    }
    else
    {
        context.console.Print(table.Text(context.console.HasOutputColour()));
    }
    return ExitCode::Done;
}

} // namespace zebhost
