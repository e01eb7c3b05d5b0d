#include "host/src/VST3/src/VST3PluginModule.h"

#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"
#include "host/BannedPluginManager.h"
#include "host/src/VST3/src/VST3ClassList.h"

#include <cstring>
#include <string_view>
#include <utility>

namespace zebaudiofilterhost::vst3
{

namespace
{

// Empty if the factory does not say.
UTF16String GetVendor(Steinberg::IPluginFactory& factory)
{
    Steinberg::PFactoryInfo info = {};
    if (factory.getFactoryInfo(&info) != Steinberg::kResultOk)
        return {};
    return zebcore::utility::UTF16FromNarrow({info.vendor, strnlen(info.vendor, sizeof(info.vendor))});
}

boost::intrusive_ptr<PluginModuleInfo> DescribeBundle(const UTF16String& path, Steinberg::IPluginFactory& factory,
                                                      std::vector<UTF16String>& filterIDs)
{
    const UTF16String vendor = GetVendor(factory);
    const File file(path);
    if (BannedPluginManager::GetInstance().IsPluginBannedStatically(file.GetName(), u"none", u"0"))
        return nullptr;
    filterIDs = ListAudioClasses(factory);
    const bool isShell = filterIDs.size() > 1;
    return new PluginModuleInfo(PluginLocator(kTechnologyVST3, path), file.GetTitle(), vendor, 0, kTechnologyVST3,
                                true, isShell);
}

} // namespace

boost::intrusive_ptr<PluginModuleInfo> VST3PluginModule::GetPluginInfo(std::vector<UTF16String>& filterIDs)
{
    ZEB_TRACE("VST3PluginModule::GetPluginInfo", "entry");
    std::vector<UTF16String> found;
    boost::intrusive_ptr<PluginModuleInfo> info;
    if (GetFactory() && GetFactory()->countClasses() > 0)
        info = DescribeBundle(GetPath(), *GetFactory(), found);
    filterIDs.swap(found);
    ZEB_TRACE("VST3PluginModule::GetPluginInfo", "done");
    return info;
}

} // namespace zebaudiofilterhost::vst3
