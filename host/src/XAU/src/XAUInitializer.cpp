#include "host/AudioFilterFactory.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginTechnology.h"
#include "host/XAU/XAUTechnology.h"
#include "host/src/XAU/src/XAUPluginSearch.h"

namespace zebaudiofilterhost::xau
{

namespace
{

// Brings Audio Units into the catalogue when the library is loaded.
class XAUInitializer
{
public:
    XAUInitializer()
    {
        AudioFilterFactory::GetInstance().RegisterFactoryFunction(GetXAUFactoryGuid(), CreateAudioFilter);
        PluginModuleInfoManager::GetInstance().AddPluginTechnology(new PluginTechnology(
            kTechnologyAudioUnit, [](const Dir&) { return GetPotentialPluginLocators(); }, CreateScanContext,
            GetDefaultAUPluginDirectories, GetPathDisplayString, false));
    }
};

const XAUInitializer sXAUInitializer;

} // namespace

} // namespace zebaudiofilterhost::xau
