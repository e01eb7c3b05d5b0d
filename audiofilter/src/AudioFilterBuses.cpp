// The plug-in's buses and the application's target buses.
#include "audiofilter/AudioFilter.h"
#include "audiofilter/src/ChannelMapEditing.h"

namespace zebaudiofilterhost
{

void AudioFilter::ClearInputBusConfiguration()
{
    mInputBuses.clear();
}

void AudioFilter::ClearOutputBusConfiguration()
{
    mOutputBuses.clear();
}

void AudioFilter::ClearBusConfiguration()
{
    ClearInputBusConfiguration();
    ClearOutputBusConfiguration();
}

void AudioFilter::AddInputBus(const AudioFilterBusDescription& bus)
{
    mInputBuses.push_back(bus);
}

void AudioFilter::AddOutputBus(const AudioFilterBusDescription& bus)
{
    mOutputBuses.push_back(bus);
}

void AudioFilter::AddInputBuses(const std::vector<AudioFilterBusDescription>& buses)
{
    for (const AudioFilterBusDescription& bus : buses)
        AddInputBus(bus);
}

void AudioFilter::AddOutputBuses(const std::vector<AudioFilterBusDescription>& buses)
{
    for (const AudioFilterBusDescription& bus : buses)
        AddOutputBus(bus);
}

const std::vector<AudioFilterBusDescription>& AudioFilter::GetInputBuses() const
{
    return mInputBuses;
}

const std::vector<AudioFilterBusDescription>& AudioFilter::GetOutputBuses() const
{
    return mOutputBuses;
}

void AudioFilter::GetBusConfiguration(std::vector<AudioFilterBusDescription>& inputs,
                                      std::vector<AudioFilterBusDescription>& outputs) const
{
    inputs = mInputBuses;
    outputs = mOutputBuses;
}

int AudioFilter::GetNumberOfInputChannels() const
{
    return channelmaps::CountChannels(mInputBuses);
}

int AudioFilter::GetNumberOfOutputChannels() const
{
    return channelmaps::CountChannels(mOutputBuses);
}

bool AudioFilter::CanUseSideChaining() const
{
    return mInputBuses.size() > 1;
}

void AudioFilter::SetChannelMapTargetChannelLayout(const ChannelLayout& layout)
{
    mMainTargetBus.SetLayout(layout);
    mTargetFormatChangedSignal();
}

ChannelLayout AudioFilter::GetChannelMapTargetChannelLayout() const
{
    return mMainTargetBus.GetLayout();
}

void AudioFilter::SetMainTargetBus(const AudioFilterBusDescription& bus)
{
    mMainTargetBus = bus;
    mTargetFormatChangedSignal();
}

void AudioFilter::SetSideChainTargetBus(const AudioFilterBusDescription& bus)
{
    mSideChainTargetBus = bus;
    mTargetFormatChangedSignal();
}

AudioFilterBusDescription AudioFilter::GetMainTargetBus() const
{
    return mMainTargetBus;
}

AudioFilterBusDescription AudioFilter::GetSideChainTargetBus() const
{
    return mSideChainTargetBus;
}

int AudioFilter::GetSideChainTargetBusChannelCount() const
{
    return mSideChainTargetBus.GetChannelCount();
}

bool AudioFilter::IsChannelFormatSupported(const ChannelLayout& layout)
{
    RequestIOConfiguration({layout}, {layout});
    std::vector<AudioFilterBusDescription> inputs;
    std::vector<AudioFilterBusDescription> outputs;
    GetBusConfiguration(inputs, outputs);
    if (inputs.empty() || outputs.size() != 1 || inputs.front().GetChannelCount() == 0)
        return false;
    return outputs.front().GetLayout().size() == layout.size();
}

} // namespace zebaudiofilterhost
