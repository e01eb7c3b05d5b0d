#include "filter/LoadFilter.h"

#include "catalogue/DisplayName.h"
#include "catalogue/LoadProblem.h"
#include "catalogue/PluginFinder.h"
#include "cli/Failure.h"

#include <foundation/zebcore/MainThreadLoop.h>
#include <host/AudioFilterDescriptor.h>
#include <host/PluginModuleInfoManager.h>
#include <utility/EffectUtils.h>

#include <exception>

namespace zebhost
{

using zebaudiofilterhost::PluginModuleInfoManager;

namespace
{

std::string Title(const Catalogue::Descriptor& descriptor)
{
    return DisplayName(*descriptor) + " in " + PlaceOf(descriptor->GetLocator());
}

void CheckUsable(const Catalogue::Descriptor& descriptor)
{
    if (descriptor->IsInternal())
    {
        return;
    }
    if (!descriptor->IsEnabled() ||
        !PluginModuleInfoManager::GetInstance().IsPluginEnabled(descriptor->GetLocator(), false))
    {
        throw Failure(ExitCode::Blocked, Title(descriptor) + " is disabled in the catalogue: 'zebhost scan " +
                                             PathOf(descriptor->GetLocator()) + "' enables it");
    }
    if (!IsInstalled(descriptor->GetLocator()))
    {
        throw Failure(ExitCode::NotLoaded, Title(descriptor) +
                                               " is gone: put it back, or run 'zebhost scan' to drop it "
                                               "from the catalogue");
    }
}

FilterPointer Create(const Catalogue::Descriptor& descriptor)
{
    try
    {
        return zebaudiofilterhost::utility::CreateAudioFilter(descriptor->GetUniqueID());
    }
    catch (const std::exception& error)
    {
        throw Failure(ExitCode::NotLoaded, Title(descriptor) + " could not be loaded: it threw an exception, \"" +
                                               error.what() + "\"; ask its maker");
    }
}

} // namespace

FilterPointer LoadFilter(const Catalogue::Descriptor& descriptor, unsigned int settleMs)
{
    CheckUsable(descriptor);
    const FilterPointer filter = Create(descriptor);
    if (filter == nullptr)
    {
        throw Failure(ExitCode::NotLoaded, LoadProblem(descriptor->GetLocator()));
    }
    Settle(settleMs);
    return filter;
}

void Settle(unsigned int milliseconds)
{
    zebcore::threads::RunMainThreadUntil({}, milliseconds);
}

} // namespace zebhost
