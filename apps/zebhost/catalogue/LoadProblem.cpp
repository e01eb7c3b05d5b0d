#include "catalogue/LoadProblem.h"

#include "catalogue/PluginFinder.h"
#include "output/PrintableText.h"

#include <host/PluginModule.h>
#include <host/TechnologyType.h>

namespace zebhost
{

std::string LoadProblem(const zebaudiofilterhost::PluginLocator& locator)
{
    std::string problem = Printable(zebaudiofilterhost::PluginModule::GetLoadProblem(locator.GetPath()));
    if (problem.empty())
    {
        if (locator.GetTechnologyType() == zebaudiofilterhost::kTechnologyAudioUnit)
        {
            return PlaceOf(locator) + " gives no instance: its binary is missing, cannot be loaded or refuses";
        }
        return PathOf(locator) + " holds no audio plug-in: none of its classes is one";
    }
    while (problem.back() == '.')
    {
        problem.pop_back();
    }
    return problem;
}

} // namespace zebhost
