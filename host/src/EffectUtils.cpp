#include "utility/EffectUtils.h"

#include "host/AudioFilterDescriptorManager.h"
#include "host/AudioFilterFactory.h"
#include "host/PluginModuleInfoManager.h"
#include "host/src/FilterIDLookup.h"

#include <algorithm>

namespace zebaudiofilterhost::utility
{

namespace
{

constexpr char16_t kVSTDigit = u'2';

bool HasSameNumber(const UTF16String& candidate, const UTF16String& id, std::size_t space)
{
    return candidate.find(u' ') == space && candidate.compare(0, space, id, 0, space) == 0;
}

// A VST 2 ID is a number, a space and a name, and the plug-in may have got a new name since the ID was stored.
boost::intrusive_ptr<AudioFilterDescriptor> FindRenamedVSTDescriptor(const UTF16String& id)
{
    const std::size_t space = id.find(u' ');
    if (id.front() != kVSTDigit || space == UTF16String::npos)
    {
        return {};
    }
    const AudioFilterDescriptorManager& manager = AudioFilterDescriptorManager::GetInstance();
    const auto found = std::find_if(manager.InfoBegin(), manager.InfoEnd(),
                                    [&id, space](const auto& descriptor)
                                    { return HasSameNumber(descriptor->GetUniqueID(), id, space); });
    return found == manager.InfoEnd() ? nullptr : *found;
}

bool MayBeCreated(const AudioFilterDescriptor& descriptor)
{
    constexpr bool kUnknownIsDisabled = false;
    return descriptor.IsEnabled() &&
           (descriptor.IsInternal() ||
            PluginModuleInfoManager::GetInstance().IsPluginEnabled(descriptor.GetLocator(), kUnknownIsDisabled));
}

} // namespace

boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& id)
{
    if (id.empty())
    {
        return {};
    }
    boost::intrusive_ptr<AudioFilterDescriptor> descriptor = FindDescriptorForFilterID(id);
    if (!descriptor)
    {
        descriptor = FindRenamedVSTDescriptor(id);
    }
    if (!descriptor || !MayBeCreated(*descriptor))
    {
        return {};
    }
    // From here on the canonical ID, whatever the caller's form was.
    return AudioFilterFactory::GetInstance().CreateAudioFilter(descriptor->GetUniqueID());
}

} // namespace zebaudiofilterhost::utility
