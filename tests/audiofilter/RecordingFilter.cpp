#include "tests/audiofilter/RecordingFilter.h"

#include "utility/ThreadUtils.h"

#include <algorithm>

namespace zebaudiofilterhost::testing
{

RecordingFilter::RecordingFilter(const std::vector<int>& inputs, const std::vector<int>& outputs)
    : AudioFilter(u"1:recording", u"Recording")
{
    for (const int channels : inputs)
        AddInputBus(MakeBus(channels));
    for (const int channels : outputs)
        AddOutputBus(MakeBus(channels));
}

RecordingFilter::~RecordingFilter()
{
    if (mDestroyed != nullptr)
        *mDestroyed = true;
}

void RecordingFilter::Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags)
{
    ProcessCall call;
    if (in != nullptr)
        call.in.assign(in, in + GetNumberOfInputChannels());
    if (out != nullptr)
        call.out.assign(out, out + GetNumberOfOutputChannels());
    call.inArray = in;
    call.outArray = out;
    call.frames = frames;
    call.inFlags = inFlags;
    mProcessCalls.push_back(call);
    outFlags |= mOutFlagsToReport;
}

void RecordingFilter::SetParameter(int index, float value)
{
    mParameterCalls.push_back(ParameterCall{index, value, CurrentThreadIDIsMainThreadID()});
    if (index >= 0 && index < GetParameterCount())
        mParameters[static_cast<std::size_t>(index)] = value;
    AudioFilter::SetParameter(index, value);
}

float RecordingFilter::GetParameter(int index) const
{
    return index >= 0 && index < GetParameterCount() ? mParameters[static_cast<std::size_t>(index)] : 0.0F;
}

void RecordingFilter::RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                             const std::vector<ChannelLayout>& outputs)
{
    ClearBusConfiguration();
    for (const ChannelLayout& layout : inputs)
        AddInputBus(AudioFilterBusDescription(u"", layout, AudioFilterBusDescription::kBusType_Main));
    for (const ChannelLayout& layout : outputs)
        AddOutputBus(AudioFilterBusDescription(u"", layout, AudioFilterBusDescription::kBusType_Main));
}

boost::intrusive_ptr<RecordingFilter> MakeFilter(const std::vector<int>& inputs, const std::vector<int>& outputs)
{
    return boost::intrusive_ptr<RecordingFilter>(new RecordingFilter(inputs, outputs));
}

AudioFilterBusDescription MakeBus(int channels)
{
    return AudioFilterBusDescription(u"", ChannelLayout(static_cast<std::size_t>(channels)),
                                     AudioFilterBusDescription::kBusType_Main);
}

ChannelMap MakeMap(int slots, const std::map<int, int>& slotToPlugChannel)
{
    ChannelMap map;
    for (int slot = 0; slot < slots; ++slot)
    {
        const auto connection = slotToPlugChannel.find(slot);
        if (connection == slotToPlugChannel.end())
            map.AddChannel(ChannelLayout(), -1);
        else
            map.AddChannel({static_cast<AudioChannelLabel>(connection->second)}, slot);
    }
    return map;
}

std::vector<int> PlugChannels(const ChannelMap& map)
{
    std::vector<int> channels;
    for (int slot = 0; slot < map.GetNumberOfChannels(); ++slot)
    {
        const ChannelLayout& layout = map.GetChannelLayout(slot);
        channels.push_back(layout.empty() ? -1 : static_cast<int>(layout.front().GetLabel()));
    }
    return channels;
}

Buffers::Buffers(int channels, int frames)
    : mSamples(static_cast<std::size_t>(channels), std::vector<float>(static_cast<std::size_t>(frames)))
{
    for (std::vector<float>& samples : mSamples)
        mPointers.push_back(samples.data());
}

void Buffers::Fill(float value)
{
    for (std::vector<float>& samples : mSamples)
        std::fill(samples.begin(), samples.end(), value);
}

} // namespace zebaudiofilterhost::testing
