#pragma once

#include <foundation/zebcore/StringTypes.h>
#include <host/AudioFilterDescriptorManager.h>
#include <host/PluginModuleInfoManager.h>

#include <vector>

namespace zebhost
{

// What the library's catalogue knows of a plug-in. [main]
struct PluginKnowledge
{
    zebaudiofilterhost::PluginModuleInfoManager::PluginInfoPtr record; // null if there is none
    std::vector<zebaudiofilterhost::AudioFilterDescriptorManager::DescriptorPtr> descriptors;

    explicit PluginKnowledge(const zebaudiofilterhost::PluginLocator& locator);

    // Into a catalogue that knows nothing of the plug-in. There must be a record.
    void PutBack() const;
    // The same as text, for PluginModuleInfoManager::AddConfiguration; empty without a record.
    zebcore::UTF8String Text() const;
};

} // namespace zebhost
