#include "tests/realtime/OwnFilter.h"

#include "tests/realtime/RealtimeProof.h"

namespace realtimeproof
{

namespace
{

using Bus = AudioFilterBusDescription;

constexpr std::size_t kGain = 0;
constexpr std::size_t kShare = 1;

Bus MakeBus(const ChannelLayout& layout, Bus::Type type)
{
    return {u"Bus", layout, type};
}

} // namespace

OwnFilter::OwnFilter() : AudioFilter(u"1:own", u"Own")
{
    mValues[kGain] = 1.0F;
}

void OwnFilter::SetParameter(int index, float value)
{
    mValues[static_cast<std::size_t>(index)].store(value, std::memory_order_relaxed);
    AudioFilter::SetParameter(index, value);
}

float OwnFilter::GetParameter(int index) const
{
    return mValues[static_cast<std::size_t>(index)].load(std::memory_order_relaxed);
}

void OwnFilter::RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                       const std::vector<ChannelLayout>& outputs)
{
    ClearBusConfiguration();
    AddInputBus(MakeBus(inputs.front(), Bus::kBusType_Main));
    AddInputBus(MakeBus(zebmediatypes::CreateMonoChannelLayout(), Bus::kBusType_SideChain));
    AddOutputBus(MakeBus(outputs.front(), Bus::kBusType_Main));
}

void OwnFilter::Process(float** in, float** out, int frames, ChannelFlags, ChannelFlags&)
{
    if (mBlock++ == mPlantedIn)
        mPlanted();
    const float gain = GetParameter(kGain);
    const float share = GetParameter(kShare);
    const int channels = GetNumberOfOutputChannels();
    const float* const side = in[channels];
    for (int channel = 0; channel < channels; ++channel)
    {
        for (int i = 0; i < frames; ++i)
            out[channel][i] = in[channel][i] * gain + side[i] * share;
    }
}

void OwnFilter::Plant(long block, std::function<void()> act)
{
    mPlantedIn = block;
    mPlanted = std::move(act);
}

void OwnSubject::WorkElsewhere(int round)
{
    AudioFilter& filter = Filter();
    filter.BeginEditing(1);
    filter.SetParameterAutomated(1, ValueOf(round));
    filter.EndEditing(1);
    filter.GetAudioFilterHost();
    filter.IsLoadingSettings();
}

INSTANTIATE_TEST_SUITE_P(Own, RealtimeProof,
                         testing::Values(Row{"Own",
                                             []
                                             {
                                                 return std::unique_ptr<Subject>(new OwnSubject);
                                             }}),
                         testing::PrintToStringParamName());

} // namespace realtimeproof
