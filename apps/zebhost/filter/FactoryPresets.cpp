#include "filter/FactoryPresets.h"

#include "output/PrintableText.h"
#include "output/Strings.h"

#include <algorithm>

namespace zebhost
{

namespace
{

std::vector<std::string> NamesByIndex(const zebaudiofilterhost::AudioFilter& filter)
{
    constexpr int kMost = 4096;
    std::vector<std::string> names;
    for (int index = 0; index < std::min(filter.GetNumFactoryPresets(), kMost); ++index)
    {
        names.push_back(Printable(filter.GetFactoryPresetName(index)));
    }
    return names;
}

} // namespace

std::vector<std::string> FactoryPresetNames(const zebaudiofilterhost::AudioFilter& filter)
{
    std::vector<std::string> names = NamesByIndex(filter);
    names.erase(std::remove(names.begin(), names.end(), std::string()), names.end());
    return names;
}

int FindFactoryPreset(const zebaudiofilterhost::AudioFilter& filter, const std::string& name)
{
    const std::vector<std::string> names = NamesByIndex(filter);
    const auto found =
        std::find_if(names.begin(), names.end(),
                     [&name](const std::string& each) { return !each.empty() && EqualIgnoringCase(each, name); });
    return found == names.end() ? -1 : static_cast<int>(found - names.begin());
}

} // namespace zebhost
