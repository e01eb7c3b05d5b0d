#include "commands/ParameterListing.h"

#include "filter/Parameters.h"
#include "filter/ValueFinder.h"
#include "output/Numbers.h"
#include "output/PrintableText.h"
#include "output/Strings.h"
#include "output/TextTable.h"

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::AudioFilterParameterInfo;

namespace
{

constexpr int kMostChoices = 256;

struct Entry
{
    int index = 0;
    boost::intrusive_ptr<AudioFilterParameterInfo> info;
    float value = 0;
    std::string text;
    std::string shown;
};

// All that holds now, before anything is asked that may set a parameter.
std::vector<Entry> Collect(AudioFilter& filter)
{
    std::vector<Entry> entries;
    for (int index = 0; index < filter.GetParameterCount(); ++index)
    {
        if (const auto info = filter.GetParameterInfo(index))
        {
            const ValueFinder finder(filter, index, *info);
            const float value = filter.GetParameter(index);
            entries.push_back({index, info, value, finder.Text(value), finder.Shown(value)});
        }
    }
    return entries;
}

Json ParameterJson(AudioFilter& filter, const Entry& entry)
{
    const AudioFilterParameterInfo& info = *entry.info;
    const ValueFinder finder(filter, entry.index, info);
    return Json{{"index", entry.index + 1},
                {"name", Printable(info.GetName())},
                {"unit", finder.Unit()},
                {"text", entry.text},
                {"value", entry.value},
                {"steps", finder.StepCount()},
                {"choices", finder.StepTexts(kMostChoices)},
                {"automatable", info.CanBeAutomated()},
                {"hidden", !info.IsExposed()}};
}

std::string Remarks(const AudioFilterParameterInfo& info, const ValueFinder& finder)
{
    std::vector<std::string> remarks;
    if (!finder.LongName().empty())
    {
        remarks.push_back(finder.LongName());
    }
    if (finder.StepCount() > 0)
    {
        remarks.push_back(Counted(static_cast<std::size_t>(finder.StepCount()) + 1, "choice"));
    }
    if (!info.CanBeAutomated())
    {
        remarks.emplace_back("not automatable");
    }
    return Joined(remarks, ", ");
}

std::string Range(const ValueFinder& finder, bool withChoices)
{
    const std::vector<std::string> choices = finder.StepTexts(withChoices ? kMostChoices : 4);
    if (!choices.empty() && (withChoices || static_cast<int>(choices.size()) == finder.StepCount() + 1))
    {
        return Joined(choices, ", ");
    }
    return finder.Shown(0) + " to " + finder.Shown(1);
}

std::string Table(const CommandContext& context, AudioFilter& filter, bool withChoices)
{
    TextTable table({"#", "NAME", "VALUE", "NORMALISED", "RANGE", ""});
    for (const Entry& entry : Collect(filter))
    {
        const ValueFinder finder(filter, entry.index, *entry.info);
        table.AddRow({std::to_string(entry.index + 1), Printable(entry.info->GetName()), entry.shown,
                      FixedNumber(static_cast<double>(entry.value), 6), Range(finder, withChoices),
                      Remarks(*entry.info, finder)});
    }
    return table.IsEmpty() ? std::string() : table.Text(context.console.HasOutputColour());
}

} // namespace

void PrintParameters(const CommandContext& context, AudioFilter& filter, Json document, bool withChoices)
{
    if (!context.WantsJson())
    {
        context.console.Print(Table(context, filter, withChoices));
        return;
    }
    document["parameters"] = Json::array();
    for (const Entry& entry : Collect(filter))
    {
        document["parameters"].push_back(ParameterJson(filter, entry));
    }
    context.Print(document);
}

} // namespace zebhost
