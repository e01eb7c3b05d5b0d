#include "filter/ParameterSetup.h"

#include "catalogue/PresetStore.h"
#include "cli/Failure.h"
#include "filter/FactoryPresets.h"
#include "filter/Parameters.h"
#include "filter/ValueFinder.h"

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;

namespace
{

void SetByText(const CommandContext& context, AudioFilter& filter, const std::string& assignment)
{
    const auto [index, text] = SplitAssignment(filter, assignment);
    const auto info = filter.GetParameterInfo(index);
    if (info == nullptr)
    {
        throw Failure(ExitCode::Usage, assignment + ": the plug-in does not describe this parameter; use --norm");
    }
    const ValueFinder::Found found = ValueFinder(filter, index, *info).Find(text);
    if (!found.exact)
    {
        context.console.Remark("zebhost: the nearest to " + assignment + " is " + found.shown);
    }
    filter.SetParameter(index, found.value);
}

} // namespace

void ApplyPreset(const CommandContext& context, AudioFilter& filter, const std::string& preset, unsigned int settleMs)
{
    const PresetStore store(context.catalogue.Folder().Presets());
    const int factory = FindFactoryPreset(filter, preset);
    if (factory >= 0 && !store.Has(filter, preset))
    {
        filter.SetFactoryPreset(factory);
    }
    else
    {
        store.Load(filter, preset);
    }
    Settle(settleMs);
}

void ApplyParameterOptions(const CommandContext& context, AudioFilter& filter, unsigned int settleMs)
{
    if (context.arguments.Has("preset"))
    {
        ApplyPreset(context, filter, context.arguments.Text("preset"), settleMs);
    }
    const std::vector<std::string> texts = context.arguments.All("set");
    const std::vector<std::string> values = context.arguments.All("norm");
    for (const std::string& assignment : texts)
    {
        SetByText(context, filter, assignment);
    }
    for (const std::string& assignment : values)
    {
        const auto [index, text] = SplitAssignment(filter, assignment);
        filter.SetParameter(index, ParseNormalised(text));
    }
    if (!texts.empty() || !values.empty())
    {
        Settle(settleMs);
    }
}

} // namespace zebhost
