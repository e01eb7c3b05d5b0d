// The settings file, and text that is added to what was read.
#include "foundation/zebcore/PropListUtils.h"
#include "fuzz/support/Catalogue.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/PluginModuleInfoManager.h"

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

PluginModuleInfoManager& Manager()
{
    return PluginModuleInfoManager::GetInstance();
}

void Load(std::u8string_view text)
{
    static const ScratchFile sScratch;
    File file = sScratch.Holding(text);
    Manager().LoadConfiguration(file);
}

const std::string& FilledText()
{
    static const std::string sText = CatalogueText();
    return sText;
}

bool IsSettings(const UTF8String& text)
{
    PropList list;
    unsigned int version = 0;
    return zebcore::proplist::utils::ReadPropList(text, list) && list.GetValue(u8"version", version) && version == 2;
}

void CheckLoading(const UTF8String& text)
{
    FillCatalogue();
    const std::string& before = FilledText();
    Load(text);
    const std::string loaded = CatalogueText();
    ExpectSoundCatalogue();
    ExpectPrivateDescriptor();
    if (loaded == before)
        return;

    TouchCatalogue();
    Expect(IsSettings(text), "a file that is no settings file changes nothing");
    Load(Manager().GetConfigurationAsXML());
    Expect(CatalogueText() == loaded, "settings that were saved come back");
}

void CheckAdding(const UTF8String& text)
{
    FillCatalogue();
    Manager().AddConfiguration(text, true);
    ExpectSoundCatalogue();
    ExpectRecord();
    ExpectPrivateDescriptor();
    if (CatalogueText() == FilledText())
        return;

    TouchCatalogue();
    PropList list;
    Expect(zebcore::proplist::utils::ReadPropList(text, list), "a text that is no list adds nothing");
}

void Run(Bytes bytes)
{
    const UTF8String text = TextOf(bytes);
    CheckLoading(text);
    CheckAdding(text);
}

const Target kTarget("settings", Run);

} // namespace
