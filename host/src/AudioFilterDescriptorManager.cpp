#include "host/AudioFilterDescriptorManager.h"

#include "foundation/zebcore/PropList.h"
#include "host/src/IndexedKeys.h"
#include "host/src/TextTable.h"

#include <algorithm>
#include <functional>
#include <iterator>
#include <set>
#include <utility>

namespace zebaudiofilterhost
{

namespace
{

const UTF8String kKey_NumDescriptors = u8"num_descriptors";
const UTF8String kKey_Descriptor = u8"descriptor";

using DescriptorPtr = AudioFilterDescriptorManager::DescriptorPtr;

std::size_t Hash(const UTF16String& id)
{
    return std::hash<UTF16String>()(id);
}

std::size_t Find(const TextTable<DescriptorPtr>& index, const UTF16String& id)
{
    return index.Find(Hash(id),
                      [&id](std::u16string_view known, const DescriptorPtr& descriptor)
                      {
                          PrefetchCounted(descriptor.get());
                          return std::ranges::equal(known, id); // == compares unit by unit
                      });
}

// Of two descriptors with one ID the first stays.
bool Enter(TextTable<DescriptorPtr>& index, const DescriptorPtr& descriptor)
{
    const UTF16String& id = descriptor->GetUniqueID();
    const bool isNew = Find(index, id) == TextTable<DescriptorPtr>::kNone;
    if (isNew)
    {
        index.Add(Hash(id), id, descriptor);
    }
    return isNew;
}

std::unique_ptr<TextTable<DescriptorPtr>>
BuildIndex(const AudioFilterDescriptorManager::DescriptorVector& descriptors)
{
    auto index = std::make_unique<TextTable<DescriptorPtr>>();
    for (const DescriptorPtr& descriptor : descriptors)
    {
        Enter(*index, descriptor);
    }
    return index;
}

} // namespace

AudioFilterDescriptorManager& AudioFilterDescriptorManager::GetInstance()
{
    static AudioFilterDescriptorManager sInstance;
    return sInstance;
}

AudioFilterDescriptorManager::AudioFilterDescriptorManager() : mDescriptorIndex(std::make_unique<DescriptorIndex>())
{
}

AudioFilterDescriptorManager::~AudioFilterDescriptorManager() = default;

void AudioFilterDescriptorManager::AddAudioFilterDescriptor(DescriptorPtr descriptor)
{
    if (!descriptor)
    {
        return;
    }
    // By pointer: the descriptor may have been read anew since it was added, and have another ID.
    const auto known = std::find(mDescriptors.begin(), mDescriptors.end(), descriptor);
    if (known != mDescriptors.end())
    {
        mDescriptors.erase(known);
        const std::size_t entry = Find(*mDescriptorIndex, descriptor->GetUniqueID());
        if (entry != DescriptorIndex::kNone)
        {
            mDescriptorIndex->Remove(entry);
        }
    }
    Enter(*mDescriptorIndex, descriptor);
    mDescriptors.push_back(std::move(descriptor));
}

AudioFilterDescriptorManager::DescriptorPtr
AudioFilterDescriptorManager::GetComponentDescriptorForID(const UTF16String& id) const
{
    const auto legacy = mLegacyToCurrentID.find(id);
    const std::size_t found = Find(*mDescriptorIndex, legacy == mLegacyToCurrentID.end() ? id : legacy->second);
    return found == DescriptorIndex::kNone ? DescriptorPtr() : mDescriptorIndex->ValueAt(found);
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
    auto index = merge ? std::make_unique<DescriptorIndex>(*mDescriptorIndex) : BuildIndex(descriptors);
    int count = 0;
    list.GetValue(kKey_NumDescriptors, count);
    for (const PropList* const section : PresentSubLists(list, kKey_Descriptor, count))
    {
        const DescriptorPtr descriptor(new AudioFilterDescriptor(*section));
        if (Enter(*index, descriptor))
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
