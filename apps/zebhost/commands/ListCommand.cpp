#include "catalogue/DisplayName.h"
#include "catalogue/PluginFinder.h"
#include "cli/Failure.h"
#include "commands/Commands.h"
#include "commands/FilterJson.h"
#include "output/PrintableText.h"
#include "output/Strings.h"
#include "output/TextTable.h"

#include <host/AudioFilterDescriptor.h>

#include <algorithm>
#include <set>

namespace zebhost
{

using zebaudiofilterhost::AudioFilterDescriptor;

namespace
{

bool Holds(const AudioFilterDescriptor& descriptor, const std::string& text)
{
    const std::vector<std::string> places = {DisplayName(descriptor), Printable(descriptor.GetVendorString()),
                                             Printable(descriptor.GetCategoryName()),
                                             ToUTF8(descriptor.GetUniqueID()), PlaceOf(descriptor.GetLocator())};
    return std::any_of(places.begin(), places.end(),
                       [&text](const std::string& place) { return ContainsIgnoringCase(place, text); });
}

std::vector<Catalogue::Descriptor> Selected(const CommandContext& context)
{
    std::vector<Catalogue::Descriptor> effects = context.catalogue.Effects();
    const std::string text = context.arguments.Text("TEXT");
    std::erase_if(effects, [&text](const Catalogue::Descriptor& each) { return !Holds(*each, text); });
    std::stable_sort(effects.begin(), effects.end(),
                     [](const auto& a, const auto& b)
                     { return Lowered(DisplayName(*a)) < Lowered(DisplayName(*b)); });
    return effects;
}

std::string Layouts(const AudioFilterDescriptor& descriptor)
{
    std::vector<std::string> layouts;
    if (descriptor.GetSupportsMono())
    {
        layouts.emplace_back("mono");
    }
    if (descriptor.GetSupportsStereo())
    {
        layouts.emplace_back("stereo");
    }
    return layouts.empty() ? "other" : Joined(layouts, ", ");
}

void PrintTable(const CommandContext& context, const std::vector<Catalogue::Descriptor>& effects)
{
    const bool isLong = context.arguments.Has("long");
    TextTable table(isLong ? std::vector<std::string>{"NAME", "VENDOR", "CATEGORY", "CHANNELS", "KIND", "ID", "PATH"}
                           : std::vector<std::string>{"NAME", "VENDOR", "CATEGORY", "CHANNELS"});
    for (const Catalogue::Descriptor& each : effects)
    {
        table.AddRow({DisplayName(*each), Printable(each->GetVendorString()), Printable(each->GetCategoryName()),
                      Layouts(*each), TechnologyName(*each), ToUTF8(each->GetUniqueID()),
                      PlaceOf(each->GetLocator())});
    }
    context.console.Print(table.Text(context.console.HasOutputColour()));
}

void PrintNames(const CommandContext& context, const std::vector<Catalogue::Descriptor>& effects)
{
    std::set<std::string> names;
    for (const Catalogue::Descriptor& each : effects)
    {
        names.insert(DisplayName(*each));
    }
    for (const std::string& name : names)
    {
        context.console.Print(name + "\n");
    }
}

void PrintJson(const CommandContext& context, const std::vector<Catalogue::Descriptor>& effects)
{
    Json document = context.NewDocument();
    document["filters"] = Json::array();
    for (const Catalogue::Descriptor& each : effects)
    {
        document["filters"].push_back(DescriptorJson(*each));
    }
    context.Print(document);
}

} // namespace

ExitCode RunList(CommandContext& context)
{
    const std::vector<Catalogue::Descriptor> effects = Selected(context);
    if (effects.empty() && context.arguments.Has("TEXT"))
    {
        throw Failure(ExitCode::NotFound, "nothing in the catalogue holds '" + context.arguments.Text("TEXT") +
                                              "': 'zebhost list' shows everything, 'zebhost scan' looks for more");
    }
    if (context.WantsJson())
    {
        PrintJson(context, effects);
    }
    else if (context.arguments.Has("names"))
    {
        PrintNames(context, effects);
    }
    else if (!effects.empty())
    {
        PrintTable(context, effects);
    }
    if (effects.empty())
    {
        context.console.Remark("zebhost: the catalogue is empty: 'zebhost scan' fills it");
    }
    return ExitCode::Done;
}

} // namespace zebhost
