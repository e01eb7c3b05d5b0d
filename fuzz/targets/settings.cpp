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

bool IsSettings(const PropList& list)
{
    unsigned int version = 0;
    return list.GetValue(u8"version", version) && version == 2;
}

void CheckLoading(const UTF8String& text)
{
    FillCatalogue();
    const UTF8String before = Manager().GetConfigurationAsXML();
    Load(text);
    PropList list;
    zebcore::proplist::utils::ReadPropList(text, list);
    Expect(IsSettings(list) || Manager().GetConfigurationAsXML() == before,
           "a file that is no settings file changes nothing");
    ExpectSoundCatalogue();
    ExpectPrivateDescriptor();

    const UTF8String saved = Manager().GetConfigurationAsXML();
    Load(saved);
    Expect(Manager().GetConfigurationAsXML() == saved, "settings that were saved come back");
}

void CheckAdding(const UTF8String& text)
{
    FillCatalogue();
    const UTF8String before = Manager().GetConfigurationAsXML();
    Manager().AddConfiguration(text, true);
    PropList list;
    Expect(zebcore::proplist::utils::ReadPropList(text, list) || Manager().GetConfigurationAsXML() == before,
           "a text that is no list adds nothing");
    ExpectSoundCatalogue();
    ExpectRecord();
    ExpectPrivateDescriptor();
}

void Run(Bytes bytes)
{
    const UTF8String text = TextOf(bytes);
    CheckLoading(text);
    CheckAdding(text);
}

const Target kTarget("settings", Run);

} // namespace
