#include "commands/FilterJson.h"

#include "catalogue/DisplayName.h"
#include "catalogue/PluginFinder.h"
#include "output/PrintableText.h"

#include <host/AudioFilterDescriptor.h>

namespace zebhost
{

using zebaudiofilterhost::AudioFilterDescriptor;

std::string TechnologyName(const AudioFilterDescriptor& descriptor)
{
    switch (descriptor.GetLocator().GetTechnologyType())
    {
    case zebaudiofilterhost::kTechnologyInternal:
        return "built in";
    case zebaudiofilterhost::kTechnologyVST:
        return "VST 2";
    case zebaudiofilterhost::kTechnologyVST3:
        return "VST 3";
    case zebaudiofilterhost::kTechnologyAudioUnit:
        return "Audio Unit";
    case zebaudiofilterhost::kTechnologyNone:
        break;
    }
    return "unknown";
}

Json DescriptorJson(const AudioFilterDescriptor& descriptor)
{
    return Json{{"id", ToUTF8(descriptor.GetUniqueID())},
                {"name", DisplayName(descriptor)},
                {"vendor", Printable(descriptor.GetVendorString())},
                {"category", Printable(descriptor.GetCategoryName())},
                {"version", descriptor.GetVersion()},
                {"technology", TechnologyName(descriptor)},
                {"path", PathOf(descriptor.GetLocator())},
                {"mono", descriptor.GetSupportsMono()},
                {"stereo", descriptor.GetSupportsStereo()}};
}

} // namespace zebhost
