#include "catalogue/DisplayName.h"

#include "catalogue/PluginFinder.h"
#include "output/PrintableText.h"

#include <host/AudioFilterDescriptor.h>

namespace zebhost
{

std::string DisplayName(const zebaudiofilterhost::AudioFilterDescriptor& descriptor)
{
    const std::string name = Printable(descriptor.GetName());
    return name.empty() ? std::filesystem::path(PathOf(descriptor.GetLocator())).stem().string() : name;
}

} // namespace zebhost
