#include "audiofilter/AudioFilterBusDescription.h"

#include <algorithm>
#include <utility>

namespace zebaudiofilterhost
{

AudioFilterBusDescription::AudioFilterBusDescription() = default;

AudioFilterBusDescription::AudioFilterBusDescription(UTF16String name, ChannelLayout layout, Type type)
    : mName(std::move(name)), mLayout(std::move(layout)), mType(type)
{
}

AudioFilterBusDescription::AudioFilterBusDescription(const AudioFilterBusDescription& other) = default;

AudioFilterBusDescription& AudioFilterBusDescription::operator=(const AudioFilterBusDescription& other)
{
    AudioFilterBusDescription copy(other);
    swap(copy);
    return *this;
}

AudioFilterBusDescription::~AudioFilterBusDescription() = default;

void AudioFilterBusDescription::swap(AudioFilterBusDescription& other) noexcept
{
    mName.swap(other.mName);
    mLayout.swap(other.mLayout);
    std::swap(mType, other.mType);
}

void AudioFilterBusDescription::SetName(const UTF16String& name)
{
    mName = name;
}

UTF16String AudioFilterBusDescription::GetName() const
{
    return mName;
}

void AudioFilterBusDescription::SetLayout(const ChannelLayout& layout)
{
    mLayout = layout;
}

ChannelLayout AudioFilterBusDescription::GetLayout() const
{
    return mLayout;
}

void AudioFilterBusDescription::SetType(Type type)
{
    mType = type;
}

AudioFilterBusDescription::Type AudioFilterBusDescription::GetType() const
{
    return mType;
}

int AudioFilterBusDescription::GetChannelCount() const
{
    return static_cast<int>(mLayout.size());
}

bool AudioFilterBusDescription::operator==(const AudioFilterBusDescription& other) const
{
    return mName == other.mName && mLayout == other.mLayout && mType == other.mType;
}

bool AudioFilterBusDescription::operator!=(const AudioFilterBusDescription& other) const
{
    return !(*this == other);
}

bool AudioFilterBusDescription::IsEquivalent(const AudioFilterBusDescription& other, bool compareLayouts) const
{
    return compareLayouts ? mLayout == other.mLayout : mLayout.size() == other.mLayout.size();
}

AudioFilterBusDescription AudioFilterBusDescription::CreateMono(const UTF16String& name, Type type)
{
    return {name, zebmediatypes::CreateMonoChannelLayout(), type};
}

AudioFilterBusDescription AudioFilterBusDescription::CreateStereo(const UTF16String& name, Type type)
{
    return {name, zebmediatypes::CreateStereoChannelLayout(), type};
}

AudioFilterBusDescription AudioFilterBusDescription::CreateSurround51(const UTF16String& name, Type type)
{
    return {name, zebmediatypes::CreateBroadcast51ChannelLayout(), type};
}

AudioFilterBusDescription AudioFilterBusDescription::CreateSurround71(const UTF16String& name, Type type)
{
    return {name, zebmediatypes::Create7_1ChannelLayout(), type};
}

bool AreAudioFilterBusDescriptionsEquivalent(const std::vector<AudioFilterBusDescription>& a,
                                             const std::vector<AudioFilterBusDescription>& b, bool)
{
    const auto sameLayout = [](const AudioFilterBusDescription& left, const AudioFilterBusDescription& right)
    {
        return left.IsEquivalent(right, true);
    };
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), sameLayout);
}

} // namespace zebaudiofilterhost
