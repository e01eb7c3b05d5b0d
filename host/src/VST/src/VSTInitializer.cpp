#include "host/AudioFilterFactory.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginTechnology.h"
#include "host/VST/VSTTechnology.h"
#include "host/src/VST/src/VSTPluginModule.h"
#include "host/src/VST/src/VSTPluginSearch.h"
#include "host/src/VST/src/VSTScanContext.h"

namespace zebaudiofilterhost::vst
{

namespace
{

// Brings VST 2 into the catalogue when the library is loaded.
class VSTInitializer
{
public:
    VSTInitializer()
    {
        AudioFilterFactory::GetInstance().RegisterFactoryFunction(GetVSTFactoryGuid(), CreateAudioFilter);
        PluginModuleInfoManager::GetInstance().AddPluginTechnology(
            new PluginTechnology(kTechnologyVST, GetPotentialPluginLocators, CreateScanContext,
                                 GetDefaultVSTPluginDirectories, GetPathDisplayString, true));
    }
};

const VSTInitializer sVSTInitializer;

} // namespace

} // namespace zebaudiofilterhost::vst
