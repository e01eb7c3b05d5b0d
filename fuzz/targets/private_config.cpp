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

// The descriptors of the configuration that is stored, which are then all that is in the catalogue.
std::string Taken()
{
    Manager().ClearAll(false);
    ExpectSoundCatalogue();
    return CatalogueText();
}

std::string TakenOfNothing()
{
    FillCatalogue();
    TouchCatalogue();
    Manager().SetPrivatePluginConfiguration(u8"");
    return Taken();
}

void Run(Bytes bytes)
{
    static const ScratchFile sScratch;
    static const std::string sNothing = TakenOfNothing();
    FillCatalogue();
    TouchCatalogue();
    const File file = sScratch.Holding(bytes);
    utility::SetPrivatePluginConfigFromFile(file.FullPath(), kVST3Folder, kVSTFolder);
    ExpectRecord();
    const std::string taken = Taken();
    if (bytes.empty())
        ExpectPrivateDescriptor();
    if (taken == sNothing)
        return;

    // A character reference can make a placeholder that was none in the text.
    const UTF8String text = Manager().GetConfigurationAsXML();
    if (text.find(u8'@') != UTF8String::npos)
        return;
    utility::SetPrivatePluginConfig(zebcore::utility::UTF8to16(text), kVST3Folder, kVSTFolder);
    Expect(Taken() == taken, "a configuration without placeholders is taken as it stands");
}

const Target kTarget("private_config", Run);

} // namespace
