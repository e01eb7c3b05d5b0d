#include "tests/plugins/hosted/HostedPlugin.h"

#include "foundation/zebcore/NativePath.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/PluginModuleInfoManager.h"
#include "host/PluginModuleScanner.h"
#include "utility/EffectUtils.h"

#include <algorithm>

namespace zebtest
{

using namespace zebaudiofilterhost;

std::vector<DescriptorPtr> Scan(const std::filesystem::path& bundle)
{
    const TechnologyType technology = bundle.extension() == ".vst3" ? kTechnologyVST3 : kTechnologyVST;
    const PluginLocator locator(technology, zebcore::filesupport::FromNativePath(bundle.string()));
    PluginModuleInfoManager::GetInstance().RemovePluginLocators({locator}); // what an earlier scan found
    const boost::intrusive_ptr<PluginModuleScanner> scanner(new PluginModuleScanner({locator}, false));
    scanner->BeginScan();
    while (scanner->ContinueScan())
    {
    }
    scanner->EndScan();
    std::vector<DescriptorPtr> found;
    const auto& catalogue = AudioFilterDescriptorManager::GetInstance();
    std::copy_if(catalogue.InfoBegin(), catalogue.InfoEnd(), std::back_inserter(found),
                 [&](const DescriptorPtr& descriptor) { return descriptor->GetLocator() == locator; });
    return found;
}

FilterPtr MakeFilter(const std::filesystem::path& bundle)
{
    const auto descriptors = Scan(bundle);
    return descriptors.empty() ? nullptr
                               : zebaudiofilterhost::utility::CreateAudioFilter(descriptors.front()->GetUniqueID());
}

std::vector<std::vector<float>> RunBlocks(AudioFilter& filter, int blocks, int frames)
{
    const auto make = [frames](int channels, float value)
    {
        return std::vector<std::vector<float>>(static_cast<std::size_t>(channels),
                                               std::vector<float>(static_cast<std::size_t>(frames), value));
    };
    auto in = make(filter.GetNumberOfInputChannels(), 0.5F);
    auto out = make(filter.GetNumberOfOutputChannels(), 9.0F);
    std::vector<float*> inPointers;
    std::vector<float*> outPointers;
    for (auto& channel : in)
        inPointers.push_back(channel.data());
    for (auto& channel : out)
        outPointers.push_back(channel.data());
    filter.SetSampleRate(48000.0F);
    filter.SetBlockSize(frames);
    filter.Resume();
    for (int block = 0; block < blocks; ++block)
    {
        ChannelFlags silent;
        filter.ProcessWithMapping(inPointers.data(), outPointers.data(), frames, ChannelFlags(), silent);
    }
    filter.Suspend();
    return out;
}

} // namespace zebtest
