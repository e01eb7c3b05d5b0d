// The process thread's road through a filter: nothing here may lock, allocate, free or call the system.
#include "audiofilter/AudioFilter.h"

#include "audiofilter/src/FloatingPointMode.h"
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
    const FloatingPointMode mode;
    const bool mapped = GetUseChannelMap();
    const bool straight = !mapped || mRoutedStraight.load(std::memory_order_relaxed);
    ChannelFlags pluginFlags = inFlags;
    float** inputs = in;
    float** outputs = out;
    if (straight && !inFlags.IsSet(mPluginInputBits))
        pluginFlags = ChannelFlags(~mPluginInputBits);
    else
        inputs = RouteInputs(in, mapped, pluginFlags);
    if (!straight)
        outputs = RouteOutputs(out);

    PumpFromProcessThread(); // Parameter changes reach the plug-in ahead of this block

    ChannelFlags result;
    Process(inputs, outputs, frames, pluginFlags, result);
    if (!straight)
        MarkSilentChannels(result);
    if (mapped && (!straight || mDelaying))
        PassChannels(in, out, frames, result);
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

void AudioFilter::PassChannels(float** in, float** out, int frames, ChannelFlags& flags)
{
    if (mDelayedChannels.empty() || !mDelayLine)
        return;
    const auto count = static_cast<unsigned int>(frames);
    if (mDelaying || PassesCrossed(in, out))
        PassDelayed(in, out, count, flags);
    else
        PassAtOnce(in, out, count, flags);
}

// Whether the output of one channel is the input of a later one, which has to be taken in before.
bool AudioFilter::PassesCrossed(float** in, float** out)
{
    for (std::size_t i = 0; i < mDelayedChannels.size(); ++i)
    {
        const int channel = Load(mDelayedChannels[i]);
        if (channel < 0)
            return false;
        if (in[channel] == out[channel])
            continue;
        for (std::size_t later = i + 1; later < mDelayedChannels.size(); ++later)
        {
            const int other = Load(mDelayedChannels[later]);
            if (other >= 0 && in[other] == out[channel])
                return true;
        }
    }
    return false;
}

// Without latency the line would give back what was just written: nothing of it is ever needed again.
void AudioFilter::PassAtOnce(float** in, float** out, unsigned int frames, ChannelFlags& flags)
{
    for (int& element : mDelayedChannels)
    {
        const int channel = Load(element);
        if (channel < 0)
            return;
        if (in[channel] != out[channel])
            zebaccelerate::utility::Copy(frames, in[channel], out[channel]);
        flags.Clear(BitOf(channel));
    }
}

// The line takes in all channels, also those that the plug-in has now: an edit of the maps may send any of them past
// it, and what it played before comes first.
void AudioFilter::PassDelayed(float** in, float** out, unsigned int frames, ChannelFlags& flags)
{
    mDelayLine->WriteData(in, frames);
    for (int& element : mDelayedChannels)
    {
        const int channel = Load(element);
        if (channel < 0)
            return;
        if (!mDelayLine->CopyDelayedOutput(static_cast<unsigned int>(channel), frames, out[channel]))
            return; // There was no memory for the line, or it was made for smaller blocks
        flags.Clear(BitOf(channel));
    }
}

} // namespace zebaudiofilterhost
