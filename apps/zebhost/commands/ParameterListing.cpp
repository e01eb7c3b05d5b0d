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

Json ParameterJson(const AudioFilter& filter, int index, const AudioFilterParameterInfo& info)
{
    const ValueFinder finder(info);
    return Json{{"index", index + 1},
                {"name", Printable(info.GetName())},
                {"unit", Printable(info.GetLabel())},
                {"text", Printable(filter.GetParameterString(index))},
                {"value", filter.GetParameter(index)},
                {"steps", info.GetStepCount()},
                {"choices", finder.StepTexts(kMostChoices)},
                {"automatable", info.CanBeAutomated()},
                {"hidden", !info.IsExposed()}};
}

std::string Remarks(const AudioFilterParameterInfo& info)
{
    std::vector<std::string> remarks;
    if (info.GetStepCount() > 0)
    {
        remarks.push_back(Counted(static_cast<std::size_t>(info.GetStepCount()) + 1, "choice"));
    }
    if (!info.CanBeAutomated())
    {
        remarks.emplace_back("not automatable");
    }
    return Joined(remarks, ", ");
}

std::string Range(const AudioFilterParameterInfo& info, bool withChoices)
{
    const ValueFinder finder(info);
    const std::vector<std::string> choices = finder.StepTexts(withChoices ? kMostChoices : 4);
    if (!choices.empty() && (withChoices || static_cast<int>(choices.size()) == info.GetStepCount() + 1))
    {
        return Joined(choices, ", ");
    }
    return finder.Shown(0) + " to " + finder.Shown(1);
}

std::string Table(const CommandContext& context, const AudioFilter& filter, bool withChoices)
{
    TextTable table({"#", "NAME", "VALUE", "NORMALISED", "RANGE", ""});
    for (int index = 0; index < filter.GetParameterCount(); ++index)
    {
        if (const auto info = filter.GetParameterInfo(index))
        {
            const float value = filter.GetParameter(index);
            table.AddRow({std::to_string(index + 1), Printable(info->GetName()), ValueFinder(*info).Shown(value),
                          FixedNumber(static_cast<double>(value), 6), Range(*info, withChoices), Remarks(*info)});
        }
    }
    return table.IsEmpty() ? std::string() : table.Text(context.console.HasOutputColour());
}

} // namespace

void PrintParameters(const CommandContext& context, const AudioFilter& filter, Json document, bool withChoices)
{
    if (!context.WantsJson())
    {
        context.console.Print(Table(context, filter, withChoices));
        return;
    }
    document["parameters"] = Json::array();
    for (int index = 0; index < filter.GetParameterCount(); ++index)
    {
        if (const auto info = filter.GetParameterInfo(index))
        {
            document["parameters"].push_back(ParameterJson(filter, index, *info));
        }
    }
    context.Print(document);
}

} // namespace zebhost
