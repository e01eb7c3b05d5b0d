#include "benchmarks/catalogue/StateFilter.h"

#include "foundation/zebcore/StringConversion.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleScanner.h"
#include "module/Module.h"
#include "utility/EffectUtils.h"

#include <cstdlib>
#include <filesystem>
#include <stdexcept>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

void Scan()
{
    Initialize();
    const PluginLocator locator(kTechnologyVST3, zebcore::utility::UTF16FromNarrow(StateBundle()));
    const boost::intrusive_ptr<PluginModuleScanner> scanner(new PluginModuleScanner({locator}, false));
    scanner->BeginScan();
    while (scanner->ContinueScan())
    {
    }
    scanner->EndScan();
}

} // namespace

std::string StateBundle()
{
    // From <bundle>/Contents/<arch>-linux/<binary>
    return std::filesystem::path(ZEB_STATE_BINARY).parent_path().parent_path().parent_path().string();
}

boost::intrusive_ptr<AudioFilter> MakeStateFilter(int bytes)
{
    static const bool sScanned = (Scan(), true);
    setenv("ZEB_STATE_BYTES", std::to_string(bytes).c_str(), 1);
    const auto filters = AudioFilterDescriptorManager::GetInstance().GetExternalInfos();
    auto filter = sScanned && !filters.empty() ? utility::CreateAudioFilter(filters.front()->GetUniqueID())
                                               : boost::intrusive_ptr<AudioFilter>();
    if (!filter)
        throw std::runtime_error("no effect in " + StateBundle());
    return filter;
}

} // namespace zebaudiofilterhost::benchmarks
