// The permanent block list, plain XML from the application's maker.
#include "foundation/zebcore/PropList.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/BannedPluginManager.h"

#include <string_view>

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

constexpr std::u8string_view kOldList = u8"<pluginlist><plugin filename='Zebra-old.vst3'/></pluginlist>";

bool IsBlocked(const UTF16String& name)
{
    return BannedPluginManager::GetInstance().IsPluginBannedStatically(name, u"none", u"0");
}

// Whether the name could be in the list, spelt out or by a reference.
bool CanHold(std::string_view text, std::string_view part)
{
    return text.find(part) != std::string_view::npos || text.find('&') != std::string_view::npos ||
           text.find('\0') != std::string_view::npos; // another encoding
}

void Run(Bytes bytes)
{
    static const ScratchFile sScratch;
    static bool sHoldsOldList = false; // as it stays while damaged lists come
    BannedPluginManager& manager = BannedPluginManager::GetInstance();
    if (!sHoldsOldList)
    {
        File oldFile = sScratch.Holding(kOldList);
        Expect(manager.LoadStaticConfiguration(oldFile), "a list is read");
    }
    File file = sScratch.Holding(bytes);
    const bool loaded = manager.LoadStaticConfiguration(file);
    sHoldsOldList = !loaded;
    Expect(loaded || IsBlocked(u"zebra-OLD.VST3"), "a damaged list leaves the old one");
    Expect(!IsBlocked(u""), "no entry is without a name");
    if (!loaded)
        return;
    const std::string text(bytes.begin(), bytes.end());
    Expect(CanHold(text, "-") || !IsBlocked(u"Zebra-old.vst3"), "a new list replaces the old one");
    Expect(manager.LoadStaticConfiguration(file), "reading again tells the same");
}

const Target kTarget("permanent_blocks", Run);

} // namespace
