#include "host/AudioFilterFactory.h"

#include "host/src/FilterIDLookup.h"

#include <utility>

namespace zebaudiofilterhost
{

AudioFilterFactory& AudioFilterFactory::GetInstance()
{
    static AudioFilterFactory sInstance;
    return sInstance;
}

AudioFilterFactory::AudioFilterFactory() = default;

AudioFilterFactory::~AudioFilterFactory() = default;

void AudioFilterFactory::RegisterFactoryFunction(const Guid& guid, FactoryFunction function)
{
    mFunctions.emplace(guid, std::move(function));
}

boost::intrusive_ptr<AudioFilter> AudioFilterFactory::CreateAudioFilter(const UTF16String& id) const
{
    const boost::intrusive_ptr<AudioFilterDescriptor> descriptor = FindDescriptorForFilterID(id);
    if (!descriptor)
    {
        return {};
    }
    const auto found = mFunctions.find(descriptor->GetFactoryGuid());
    if (found == mFunctions.end())
    {
        return {};
    }
    // The function gets the caller's form of the ID, not the canonical one: it parses both.
    return found->second(id);
}

} // namespace zebaudiofilterhost
