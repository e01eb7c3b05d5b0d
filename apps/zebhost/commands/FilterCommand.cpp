#include "commands/FilterCommand.h"

#include "catalogue/DisplayName.h"
#include "catalogue/FilterSelector.h"
#include "catalogue/PluginFinder.h"

#include <host/AudioFilterDescriptor.h>

namespace zebhost
{

FilterOfCommand::FilterOfCommand(const CommandContext& context, unsigned int settleMs)
    : mDescriptor(FilterSelector(context.catalogue).Select(context.arguments.Text("FILTER")))
    , mAdvice("its maker should know; 'zebhost block " + SelectorWord(mDescriptor->GetLocator()) +
              "' keeps it from being used")
    , mCrashGuard(PlaceOf(mDescriptor->GetLocator()), mAdvice)
    , mThrowGuard(PlaceOf(mDescriptor->GetLocator()), "try other settings; " + mAdvice)
    , mFilter(LoadFilter(mDescriptor, settleMs))
{
}

std::string FilterOfCommand::Name() const
{
    return DisplayName(*mDescriptor);
}

} // namespace zebhost
