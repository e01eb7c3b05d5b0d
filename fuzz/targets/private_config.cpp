// The private plug-in configuration, a text with placeholders.
#include "utility/PrivatePluginUtils.h"

#include "foundation/zebcore/StringConversion.h"
#include "fuzz/support/Catalogue.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

const UTF16String kVST3Folder = u"/opt/Hall & Room/<private>";
const UTF16String kVSTFolder = u"/opt/p/vst3";

PluginModuleInfoManager& Manager()
{
    return PluginModuleInfoManager::GetInstance();
}

// What the catalogue becomes with the configuration that is stored.
UTF8String Taken()
{
    Manager().ClearAll(false);
    ExpectSoundCatalogue();
    return Manager().GetConfigurationAsXML();
}

void Run(Bytes bytes)
{
    static const ScratchFile sScratch;
    FillCatalogue();
    const File file = sScratch.Holding(bytes);
    utility::SetPrivatePluginConfigFromFile(file.FullPath(), kVST3Folder, kVSTFolder);
    ExpectRecord();
    const UTF8String taken = Taken();
    if (bytes.empty())
        ExpectPrivateDescriptor();

    // A character reference can make a placeholder that was none in the text.
    if (taken.find(u8'@') != UTF8String::npos)
        return;
    utility::SetPrivatePluginConfig(zebcore::utility::UTF8to16(taken), kVST3Folder, kVSTFolder);
    Expect(Taken() == taken, "a configuration without placeholders is taken as it stands");
}

const Target kTarget("private_config", Run);

} // namespace
