#include "commands/Commands.h"
#include "commands/FilterCommand.h"
#include "commands/FilterJson.h"
#include "commands/ParameterListing.h"
#include "filter/ParameterSetup.h"

namespace zebhost
{

ExitCode RunParams(CommandContext& context)
{
    const FilterOfCommand filter(context);
    ApplyParameterOptions(context, *filter);
    Json document = context.NewDocument();
    document["filter"] = DescriptorJson(filter.Descriptor());
    PrintParameters(context, *filter, std::move(document), context.arguments.Has("choices"));
    if (filter->GetParameterCount() == 0)
    {
        context.console.Remark("zebhost: " + filter.Name() + " has no parameters");
    }
    return ExitCode::Done;
}

} // namespace zebhost
