#include "audiofilter/AudioFilterProxy.h"

#include "audiofilter/src/BusLayouts.h"
#include "utility/EffectUtils.h"

namespace zebaudiofilterhost
{

namespace
{

constexpr unsigned long kFirstCount = 1;
constexpr unsigned long kSecondCount = 6;
constexpr AudioFilterParameterInfoUnit kNoUnit = AudioFilterParameterInfoUnit(0);

} // namespace

AudioFilterProxy::AudioFilterProxy(const UTF16String& id, const UTF16String& displayName, unsigned int parameterCount,
                                   bool usesChunkData)
    : AudioFilter(id, displayName)
    , mZombieList(std::make_unique<PropList>())
    , mZombiePreset(*mZombieList)
    , mUsesChunkData(usesChunkData)
{
    for (unsigned int index = 0; index < parameterCount; ++index)
    {
        AppendParameter(0.0F, kNoUnit, false);
    }
}

AudioFilterProxy::AudioFilterProxy(const boost::intrusive_ptr<AudioFilter>& filter)
    : AudioFilter(filter->GetID(), filter->GetDisplayName())
    , mZombieList(std::make_unique<PropList>())
    , mZombiePreset(*mZombieList)
    , mUsesChunkData(filter->DoPresetsUseChunkData())
{
    AddInputBuses(filter->GetInputBuses());
    AddOutputBuses(filter->GetOutputBuses());
    filter->SaveSettings(mZombiePreset);
    AudioFilter::SetSampleRate(filter->mSampleRate);
    AudioFilter::SetBlockSize(filter->mBlockSize);

    const int count = filter->GetParameterCount();
    for (int index = 0; index < count; ++index)
    {
        const float value = filter->GetParameter(index);
        const boost::intrusive_ptr<AudioFilterParameterInfo> info = filter->GetParameterInfo(index);
        AppendParameter(value, info ? info->GetUnit() : kNoUnit, info && info->CanBeAutomated());
    }

    SetUseChannelMap(filter->GetUseChannelMap());
    SetChannelMap(filter->GetChannelMap(kDirection_Input), kDirection_Input);
    SetChannelMap(filter->GetChannelMap(kDirection_Output), kDirection_Output);
    SetPresetNameAndDirtyState(filter->GetPresetNameAndDirtyState());
}

AudioFilterProxy::~AudioFilterProxy() = default;

int AudioFilterProxy::GetParameterCount() const
{
    return static_cast<int>(mParameterValues.size());
}

void AudioFilterProxy::SetParameter(int index, float value)
{
    if (IsParameter(index))
    {
        mParameterValues[static_cast<std::size_t>(index)].store(value, std::memory_order_relaxed);
    }
    AudioFilter::SetParameter(index, value);
}

float AudioFilterProxy::GetParameter(int index) const
{
    if (!IsParameter(index))
        return 0.0F;
    return mParameterValues[static_cast<std::size_t>(index)].load(std::memory_order_relaxed);
}

boost::intrusive_ptr<AudioFilterParameterInfo> AudioFilterProxy::GetParameterInfo(int index) const
{
    if (!IsParameter(index))
    {
        return nullptr;
    }
    return mParameterInfos[static_cast<std::size_t>(index)];
}

bool AudioFilterProxy::DoPresetsUseChunkData() const
{
    return mUsesChunkData;
}

bool AudioFilterProxy::LoadSettings(const PresetData& preset)
{
    mZombiePreset.SetDataFromExistingPreset(preset);
    return true;
}

void AudioFilterProxy::SaveSettings(PresetData& preset) const
{
    preset.SetDataFromExistingPreset(mZombiePreset);
}

bool AudioFilterProxy::IsProxy() const
{
    return true;
}

void AudioFilterProxy::SetParameterDisplayName(int index, const UTF16String& name)
{
    if (IsParameter(index))
    {
        mParameterInfos[static_cast<std::size_t>(index)]->SetName(name);
    }
}

boost::intrusive_ptr<AudioFilter> AudioFilterProxy::CreateAudioFilterFromZombieState() const
{
    boost::intrusive_ptr<AudioFilter> filter = utility::CreateAudioFilter(GetID());
    if (!filter)
    {
        return nullptr;
    }
    filter->SetSampleRate(mSampleRate);
    filter->SetBlockSize(mBlockSize);
    RequestBuses(*filter, GetInputBuses(), GetOutputBuses());
    filter->LoadSettings(mZombiePreset);
    filter->SetUseChannelMap(GetUseChannelMap());
    filter->SetChannelMap(GetChannelMap(kDirection_Input), kDirection_Input);
    filter->SetChannelMap(GetChannelMap(kDirection_Output), kDirection_Output);
    filter->SetPresetNameAndDirtyState(GetPresetNameAndDirtyState());
    return filter;
}

bool AudioFilterProxy::IsParameter(int index) const
{
    return index >= 0 && static_cast<std::size_t>(index) < mParameterValues.size();
}

void AudioFilterProxy::AppendParameter(float value, AudioFilterParameterInfoUnit unit, bool canBeAutomated)
{
    const int index = static_cast<int>(mParameterValues.size());
    mParameterValues.emplace_back(value);
    mParameterInfos.push_back(new GenericParameterInfo(UTF16String(), UTF16String(), unit, index, 0.0F, 1.0F,
                                                       canBeAutomated, false, kFirstCount, kSecondCount));
}

} // namespace zebaudiofilterhost
