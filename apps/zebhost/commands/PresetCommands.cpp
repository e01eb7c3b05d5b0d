#include "catalogue/PresetStore.h"
#include "commands/Commands.h"
#include "commands/FilterCommand.h"
#include "commands/FilterJson.h"
#include "commands/ParameterListing.h"
#include "filter/FactoryPresets.h"
#include "filter/ParameterSetup.h"
#include "output/PrintableText.h"
#include "output/TextTable.h"

#include <host/AudioFilterDescriptor.h>

#include <optional>

namespace zebhost
{

namespace
{

PresetStore Store(const CommandContext& context)
{
    return PresetStore(context.catalogue.Folder().Presets());
}

struct Listing
{
    std::vector<PresetStore::Entry> stored;
    std::vector<std::string> factory;
};

Listing Collect(const CommandContext& context)
{
    if (!context.arguments.Has("FILTER"))
    {
        return {Store(context).List({}), {}};
    }
    const FilterOfCommand filter(context);
    return {Store(context).List(ToUTF8(filter->GetID())), FactoryPresetNames(*filter)};
}

Json ListingJson(const CommandContext& context, const Listing& listing)
{
    Json document = context.NewDocument();
    document["stored"] = Json::array();
    for (const PresetStore::Entry& entry : listing.stored)
    {
        document["stored"].push_back(Json{{"name", entry.name},
                                          {"filterId", entry.filterID},
                                          {"filter", entry.filterName},
                                          {"file", entry.file.string()}});
    }
    document["factory"] = listing.factory;
    return document;
}

} // namespace

ExitCode RunPresetSave(CommandContext& context)
{
    const FilterOfCommand filter(context);
    ApplyParameterOptions(context, *filter);
    const std::filesystem::path file =
        Store(context).Save(*filter, context.arguments.Text("PRESET"), context.arguments.Has("overwrite"));
    if (context.WantsJson())
    {
        Json document = context.NewDocument();
        document["filter"] = DescriptorJson(filter.Descriptor());
        document["file"] = file.string();
        context.Print(document);
    }
    context.console.Remark("zebhost: saved " + file.string());
    return ExitCode::Done;
}

ExitCode RunPresetLoad(CommandContext& context)
{
    const FilterOfCommand filter(context);
    ApplyPreset(context, *filter, context.arguments.Text("PRESET"), kDefaultSettleMs);
    Json document = context.NewDocument();
    document["filter"] = DescriptorJson(filter.Descriptor());
    PrintParameters(context, *filter, std::move(document), false);
    return ExitCode::Done;
}

ExitCode RunPresetList(CommandContext& context)
{
    const Listing listing = Collect(context);
    if (context.WantsJson())
    {
        context.Print(ListingJson(context, listing));
        return ExitCode::Done;
    }
    TextTable table({"PRESET", "FILTER", "FILE"});
    for (const PresetStore::Entry& entry : listing.stored)
    {
        table.AddRow({entry.name, entry.filterName, entry.file.string()});
    }
    for (const std::string& name : listing.factory)
    {
        table.AddRow({name, "", "(in the plug-in)"});
    }
    if (table.IsEmpty())
    {
        context.console.Remark("zebhost: there are no presets: 'zebhost preset save' makes one");
        return ExitCode::Done;
    }
    context.console.Print(table.Text(context.console.HasOutputColour()));
    return ExitCode::Done;
}

} // namespace zebhost
