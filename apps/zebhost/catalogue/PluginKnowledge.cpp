#include "catalogue/PluginKnowledge.h"

#include <foundation/zebcore/PropList.h>
#include <foundation/zebcore/PropListUtils.h>
#include <host/AudioFilterDescriptor.h>
#include <host/PluginModuleInfo.h>

#include <algorithm>
#include <iterator>

namespace zebhost
{

using zebaudiofilterhost::AudioFilterDescriptorManager;
using zebaudiofilterhost::PluginLocator;
using zebaudiofilterhost::PluginModuleInfoManager;
using zebcore::UTF8String;

namespace
{

UTF8String Numbered(UTF8String name, std::size_t number)
{
    const std::string digits = std::to_string(number);
    return name.append(digits.begin(), digits.end());
}

} // namespace

PluginKnowledge::PluginKnowledge(const PluginLocator& locator)
    : record(PluginModuleInfoManager::GetInstance().FindPluginInfo(locator))
{
    const auto all = AudioFilterDescriptorManager::GetInstance().GetExternalInfos();
    std::copy_if(all.begin(), all.end(), std::back_inserter(descriptors),
                 [&locator](const auto& descriptor) { return descriptor->GetLocator() == locator; });
}

void PluginKnowledge::PutBack() const
{
    PluginModuleInfoManager::GetInstance().AddPluginModuleInfo(record);
    for (const auto& descriptor : descriptors)
    {
        AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(descriptor);
    }
}

// A catalogue's file with one plug-in in it.
UTF8String PluginKnowledge::Text() const
{
    UTF8String text;
    if (record != nullptr)
    {
        zebcore::proplist::PropList list;
        list.SetValue(u8"num_plugin_infos", 1);
        record->Write(list.GetOrCreateSubList(Numbered(u8"plugin_info", 0)));
        list.SetValue(u8"num_descriptors", static_cast<int>(descriptors.size()));
        for (std::size_t index = 0; index < descriptors.size(); ++index)
        {
            descriptors[index]->Write(list.GetOrCreateSubList(Numbered(u8"descriptor", index)));
        }
        zebcore::proplist::utils::WritePropList(text, list);
    }
    return text;
}

} // namespace zebhost
