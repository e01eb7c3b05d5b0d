#include "host/AudioFilterFactory.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginTechnology.h"
#include "host/VST3/VST3Technology.h"
#include "host/src/VST3/src/VST3PluginModule.h"
#include "host/src/VST3/src/VST3PluginSearch.h"
#include "host/src/VST3/src/VST3ScanContext.h"

namespace zebaudiofilterhost::vst3
{

namespace
{

// Brings VST 3 into the catalogue when the library is loaded.
class VST3Initializer
{
public:
    VST3Initializer()
    {
        AudioFilterFactory::GetInstance().RegisterFactoryFunction(GetVST3FactoryGuid(), CreateAudioFilter);
        PluginModuleInfoManager::GetInstance().AddPluginTechnology(
            new PluginTechnology(kTechnologyVST3, GetPotentialPluginLocators, CreateScanContext,
                                 GetDefaultVST3PluginDirectories, GetPathDisplayString, false));
    }
};

const VST3Initializer sVST3Initializer;

} // namespace

} // namespace zebaudiofilterhost::vst3
