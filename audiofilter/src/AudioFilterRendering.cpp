// The process thread's road through a filter: nothing here may lock, allocate, free or call the system.
#include "audiofilter/AudioFilter.h"

#include "foundation/zebaccelerate/FloatBuffer.h"

namespace zebaudiofilterhost
{

namespace
{

constexpr ChannelFlags kAllSilent(~0ULL);

// The main thread may store a new index at any time; each is read once a block.
int Load(int& element)
{
    return std::atomic_ref<int>(element).load(std::memory_order_relaxed);
}

unsigned long long BitOf(int channel)
{
    return ChannelBit(static_cast<unsigned int>(channel));
}

} // namespace

void AudioFilter::Process(float**, float**, int, ChannelFlags, ChannelFlags& outFlags)
{
    outFlags = kAllSilent;
}

void AudioFilter::ProcessWithMapping(float** in, float** out, int frames, ChannelFlags inFlags,
                                     ChannelFlags& outFlags)
{
    const bool mapped = GetUseChannelMap();
    ChannelFlags pluginFlags = inFlags;
    float** const inputs = RouteInputs(in, mapped, pluginFlags);
    float** const outputs = mapped ? RouteOutputs(out) : out;

    PumpFromProcessThread(); // Parameter changes reach the plug-in ahead of this block

    ChannelFlags result;
    Process(inputs, outputs, frames, pluginFlags, result);
    if (mapped)
    {
        MarkSilentChannels(result);
        PassDelayedChannels(in, out, frames, result);
    }
    outFlags = result;
}

float** AudioFilter::RouteInputs(float** in, bool mapped, ChannelFlags& flags)
{
    if (mapped && mInputChannelIndices.empty())
        return in;
    ChannelFlags pluginFlags = kAllSilent;
    for (std::size_t i = 0; i < mInputPointers.size(); ++i)
    {
        int channel = static_cast<int>(i);
        if (mapped)
            channel = i < mInputChannelIndices.size() ? Load(mInputChannelIndices[i]) : -1;
        if (channel >= 0 && !flags.IsSet(BitOf(channel)))
        {
            mInputPointers[i] = in[channel];
            pluginFlags.Clear(ChannelBit(static_cast<unsigned int>(i)));
        }
        else
            mInputPointers[i] = mSilenceBuffer.data();
    }
    flags = pluginFlags;
    return mInputPointers.empty() ? in : mInputPointers.data();
}

float** AudioFilter::RouteOutputs(float** out)
{
    if (mOutputChannelIndices.empty())
        return out;
    for (std::size_t i = 0; i < mOutputPointers.size(); ++i)
    {
        const int channel = Load(mOutputChannelIndices[i]);
        mOutputPointers[i] = channel >= 0 ? out[channel] : mDiscardBuffer.data();
    }
    return mOutputPointers.data();
}

void AudioFilter::MarkSilentChannels(ChannelFlags& flags)
{
    for (int& element : mSilentChannels)
    {
        const int channel = Load(element);
        if (channel < 0)
            return;
        flags.Set(BitOf(channel));
    }
}

void AudioFilter::PassDelayedChannels(float** in, float** out, int frames, ChannelFlags& flags)
{
    if (mDelayedChannels.empty() || !mDelayLine)
        return;
    const auto count = static_cast<unsigned int>(frames);
    mDelayLine->WriteData(in, count);
    float** const delayed = mDelayLine->GetDelayedOutput(count);
    if (delayed == nullptr) // There was no memory for the line, or it was made for smaller blocks
        return;
    for (int& element : mDelayedChannels)
    {
        const int channel = Load(element);
        if (channel < 0)
            return;
        zebaccelerate::utility::Copy(count, delayed[channel], out[channel]);
        flags.Clear(BitOf(channel));
    }
}

} // namespace zebaudiofilterhost
