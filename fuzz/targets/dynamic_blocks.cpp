// The file of plug-ins that took the process down.
#include "foundation/zebcore/PropListUtils.h"
#include "fuzz/support/ListText.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/BannedPluginManager.h"

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

BannedPluginManager& Manager()
{
    return BannedPluginManager::GetInstance();
}

std::string Listed()
{
    PropList list;
    Manager().WriteBannedPlugins(list);
    return ListText(list);
}

// The list that each input finds.
void BlockOne()
{
    Manager().ReadBannedPlugins(PropList());
    Manager().AddBannedPlugin(PluginLocator(kTechnologyVST3, u"/opt/vst3/Blocked.vst3"));
}

bool IsBlockList(const UTF8String& text)
{
    PropList list;
    unsigned int version = 0;
    return zebcore::proplist::utils::ReadPropList(text, list) && list.GetValue(u8"version", version) && version == 1;
}

void Run(Bytes bytes)
{
    static const ScratchFile sScratch;
    static const std::string sBefore = (BlockOne(), Listed());
    BlockOne();
    File file = sScratch.Holding(bytes);
    Manager().LoadConfiguration(file);
    const std::string loaded = Listed();
    if (loaded == sBefore)
        return;
    Expect(IsBlockList(TextOf(bytes)), "a file that is no block list changes nothing");
    for (auto locator = Manager().BannedBegin(); locator != Manager().BannedEnd(); ++locator)
        Expect(Manager().IsPluginBanned(*locator), "what is listed is blocked");

    PropList list;
    Manager().WriteBannedPlugins(list);
    Manager().ReadBannedPlugins(list);
    Expect(Listed() == loaded, "a list that was written comes back");
}

const Target kTarget("dynamic_blocks", Run);

} // namespace
