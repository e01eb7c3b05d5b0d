#include "host/AudioFilterDescriptorManager.h"

#include "foundation/zebcore/PropList.h"
#include "host/src/IndexedKeys.h"

#include <algorithm>
#include <iterator>
#include <set>
#include <utility>

namespace zebaudiofilterhost
{

namespace
{

const UTF8String kKey_NumDescriptors = u8"num_descriptors";
const UTF8String kKey_Descriptor = u8"descriptor";

} // namespace

AudioFilterDescriptorManager& AudioFilterDescriptorManager::GetInstance()
{
    static AudioFilterDescriptorManager sInstance;
    return sInstance;
}

AudioFilterDescriptorManager::AudioFilterDescriptorManager() = default;

AudioFilterDescriptorManager::~AudioFilterDescriptorManager() = default;

void AudioFilterDescriptorManager::AddAudioFilterDescriptor(DescriptorPtr descriptor)
{
    if (!descriptor)
    {
        return;
    }
    // Every ID of the vector is in the map, so the search is saved for a new ID: adding takes constant time.
    const auto known = mDescriptorIndex.find(descriptor->GetUniqueID());
    if (known != mDescriptorIndex.end())
    {
        const auto found = std::find(mDescriptors.begin(), mDescriptors.end(), descriptor);
        if (found != mDescriptors.end())
        {
            mDescriptors.erase(found);
            mDescriptorIndex.erase(known);
        }
    }
    mDescriptors.push_back(descriptor);
    mDescriptorIndex.emplace(descriptor->GetUniqueID(), std::move(descriptor));
}

AudioFilterDescriptorManager::DescriptorPtr
AudioFilterDescriptorManager::GetComponentDescriptorForID(const UTF16String& id) const
{
    const auto legacy = mLegacyToCurrentID.find(id);
    const auto found = mDescriptorIndex.find(legacy == mLegacyToCurrentID.end() ? id : legacy->second);
    return found == mDescriptorIndex.end() ? DescriptorPtr() : found->second;
}

void AudioFilterDescriptorManager::AddLegacyToCurrentIDMapping(const UTF16String& legacy, const UTF16String& current)
{
    mLegacyToCurrentID.emplace(legacy, current);
}

AudioFilterDescriptorManager::Iterator AudioFilterDescriptorManager::InfoBegin() const
{
    return mDescriptors.begin();
}

AudioFilterDescriptorManager::Iterator AudioFilterDescriptorManager::InfoEnd() const
{
    return mDescriptors.end();
}

AudioFilterDescriptorManager::DescriptorVector AudioFilterDescriptorManager::GetInternalInfos() const
{
    DescriptorVector infos;
    std::copy_if(mDescriptors.begin(), mDescriptors.end(), std::back_inserter(infos),
                 [](const DescriptorPtr& descriptor) { return descriptor->IsInternal(); });
    return infos;
}

AudioFilterDescriptorManager::DescriptorVector AudioFilterDescriptorManager::GetExternalInfos() const
{
    DescriptorVector infos;
    std::copy_if(mDescriptors.begin(), mDescriptors.end(), std::back_inserter(infos),
                 [](const DescriptorPtr& descriptor) { return !descriptor->IsInternal(); });
    return infos;
}

void AudioFilterDescriptorManager::ClearExternalInfos()
{
    mDescriptors = GetInternalInfos();
    mDescriptorIndex = BuildIndex(mDescriptors);
}

void AudioFilterDescriptorManager::ClearInfosForLocator(const PluginLocator& locator)
{
    ClearInfosForLocators({locator});
}

void AudioFilterDescriptorManager::ClearInfosForLocators(const std::vector<PluginLocator>& locators)
{
    const std::set<PluginLocator> doomed(locators.begin(), locators.end());
    std::erase_if(mDescriptors,
                  [&doomed](const DescriptorPtr& descriptor) { return doomed.contains(descriptor->GetLocator()); });
    mDescriptorIndex = BuildIndex(mDescriptors);
}

void AudioFilterDescriptorManager::ReadExternalComponentDescriptors(const PropList& list, bool merge)
{
    DescriptorVector descriptors = merge ? mDescriptors : GetInternalInfos();
    DescriptorIndex index = merge ? mDescriptorIndex : BuildIndex(descriptors);
    int count = 0;
    list.GetValue(kKey_NumDescriptors, count);
    for (const PropList* const section : PresentSubLists(list, kKey_Descriptor, count))
    {
        const DescriptorPtr descriptor(new AudioFilterDescriptor(*section));
        if (index.emplace(descriptor->GetUniqueID(), descriptor).second)
        {
            descriptors.push_back(descriptor);
        }
    }
    mDescriptors.swap(descriptors);
    mDescriptorIndex.swap(index);
}

void AudioFilterDescriptorManager::WriteExternalComponentDescriptors(PropList& list) const
{
    const DescriptorVector infos = GetExternalInfos();
    list.SetValue(kKey_NumDescriptors, static_cast<int>(infos.size()));
    for (std::size_t index = 0; index < infos.size(); ++index)
    {
        infos[index]->Write(list.GetOrCreateSubList(IndexedKey(kKey_Descriptor, index)));
    }
}

AudioFilterDescriptorManager::DescriptorIndex
AudioFilterDescriptorManager::BuildIndex(const DescriptorVector& descriptors)
{
    DescriptorIndex index;
    for (const DescriptorPtr& descriptor : descriptors)
    {
        index.emplace(descriptor->GetUniqueID(), descriptor);
    }
    return index;
}

AudioFilterDescriptorManager::DescriptorMap
AudioFilterDescriptorManager::BuildComponentDescriptorMap(const DescriptorVector& descriptors) const
{
    DescriptorMap descriptorMap;
    for (const DescriptorPtr& descriptor : descriptors)
    {
        descriptorMap.emplace(descriptor->GetUniqueID(), descriptor);
    }
    return descriptorMap;
}

} // namespace zebaudiofilterhost
