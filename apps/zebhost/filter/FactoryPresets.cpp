#include "filter/FactoryPresets.h"

#include "output/PrintableText.h"

#include <algorithm>

namespace zebhost
{

std::vector<std::string> FactoryPresetNames(const zebaudiofilterhost::AudioFilter& filter)
{
    constexpr int kMost = 4096;
    std::vector<std::string> names;
    for (int index = 0; index < std::min(filter.GetNumFactoryPresets(), kMost); ++index)
    {
        names.push_back(Printable(filter.GetFactoryPresetName(index)));
    }
    return names;
}

} // namespace zebhost
