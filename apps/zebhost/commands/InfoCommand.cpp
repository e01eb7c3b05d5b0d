#include "audio/ChannelNames.h"
#include "catalogue/PluginFinder.h"
#include "catalogue/PresetStore.h"
#include "commands/Commands.h"
#include "commands/FilterCommand.h"
#include "commands/FilterJson.h"
#include "filter/FactoryPresets.h"
#include "output/PrintableText.h"
#include "output/Strings.h"

#include <host/AudioFilterDescriptor.h>

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::AudioFilterBusDescription;

namespace
{

constexpr unsigned int kEndless = 0xFFFFFFFF;

bool IsSideChain(const AudioFilterBusDescription& bus)
{
    return bus.GetType() == AudioFilterBusDescription::kBusType_SideChain;
}

// Audio Units have no buses before something is asked of them.
void ShowBuses(AudioFilter& filter)
{
    const zebaudiofilterhost::ChannelLayout stereo = zebmediatypes::CreateStereoChannelLayout();
    if (filter.GetInputBuses().empty() && filter.GetOutputBuses().empty())
    {
        filter.RequestIOConfiguration({stereo}, {stereo});
    }
}

Json BusesJson(const std::vector<AudioFilterBusDescription>& buses)
{
    Json list = Json::array();
    for (const AudioFilterBusDescription& bus : buses)
    {
        list.push_back(Json{{"name", Printable(bus.GetName())},
                            {"type", IsSideChain(bus) ? "side-chain" : "main"},
                            {"channels", ChannelNames(bus.GetLayout())}});
    }
    return list;
}

std::string BusLine(const AudioFilterBusDescription& bus)
{
    return Printable(bus.GetName()) + ": " + Counted(static_cast<std::size_t>(bus.GetChannelCount()), "channel") +
           " (" + Joined(ChannelNames(bus.GetLayout()), " ") + ")" + (IsSideChain(bus) ? ", side chain" : "");
}

std::string BusLines(const std::string& head, const std::vector<AudioFilterBusDescription>& buses)
{
    std::string text;
    for (const AudioFilterBusDescription& bus : buses)
    {
        text += head + BusLine(bus) + "\n";
    }
    return buses.empty() ? head + "none\n" : text;
}

std::string TailText(unsigned int tail)
{
    return tail == kEndless ? "endless" : Counted(tail, "frame");
}

std::vector<std::string> StoredPresets(const CommandContext& context, const AudioFilter& filter)
{
    std::vector<std::string> names;
    for (const PresetStore::Entry& entry :
         PresetStore(context.catalogue.Folder().Presets()).List(ToUTF8(filter.GetID())))
    {
        names.push_back(entry.name);
    }
    return names;
}

Json Document(const CommandContext& context, const FilterOfCommand& filter)
{
    Json document = context.NewDocument();
    Json info = DescriptorJson(filter.Descriptor());
    info["inputs"] = BusesJson(filter->GetInputBuses());
    info["outputs"] = BusesJson(filter->GetOutputBuses());
    info["latency"] = filter->GetInitialDelay();
    info["tail"] = filter->GetTail() == kEndless ? Json(nullptr) : Json(filter->GetTail());
    info["tailIsEndless"] = filter->GetTail() == kEndless;
    info["parameters"] = filter->GetParameterCount();
    info["editor"] = filter->HasCustomEditor();
    info["factoryPresets"] = FactoryPresetNames(*filter);
    info["storedPresets"] = StoredPresets(context, *filter);
    document["filter"] = info;
    return document;
}

std::string Text(const CommandContext& context, const FilterOfCommand& filter)
{
    const zebaudiofilterhost::AudioFilterDescriptor& descriptor = filter.Descriptor();
    const std::string vendor = Printable(descriptor.GetVendorString());
    const std::string category = Printable(descriptor.GetCategoryName());
    const std::vector<std::string> factory = FactoryPresetNames(*filter);
    const std::vector<std::string> stored = StoredPresets(context, *filter);
    return filter.Name() + (vendor.empty() ? "" : " by " + vendor) + "\n" +                                   //
           "ID:           " + ToUTF8(descriptor.GetUniqueID()) + "\n" +                                       //
           "Kind:         " + TechnologyName(descriptor) + (category.empty() ? "" : ", " + category) + "\n" + //
           "Path:         " + PlaceOf(descriptor.GetLocator()) + "\n" +                                       //
           BusLines("Input:        ", filter->GetInputBuses()) +                                              //
           BusLines("Output:       ", filter->GetOutputBuses()) +                                             //
           "Latency:      " + Counted(static_cast<std::size_t>(std::max(filter->GetInitialDelay(), 0)), "frame") +
           "\n" + "Tail:         " + TailText(filter->GetTail()) + "\n" + //
           "Parameters:   " + std::to_string(filter->GetParameterCount()) + "\n" +
           "Editor:       " + (filter->HasCustomEditor() ? "yes" : "no") + "\n" +
           "Own presets:  " + (factory.empty() ? "none" : Joined(factory, ", ")) + "\n" +
           "Your presets: " + (stored.empty() ? "none" : Joined(stored, ", ")) + "\n";
}

} // namespace

ExitCode RunInfo(CommandContext& context)
{
    const FilterOfCommand filter(context);
    ShowBuses(*filter);
    if (context.WantsJson())
    {
        context.Print(Document(context, filter));
    }
    else
    {
        context.console.Print(Text(context, filter));
    }
    return ExitCode::Done;
}

} // namespace zebhost
