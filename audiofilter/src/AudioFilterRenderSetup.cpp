// What the main thread prepares for rendering, and how map edits reach running audio.
#include "audiofilter/AudioFilter.h"
#include "audiofilter/src/ChannelMapEditing.h"
#include "foundation/zebcore/Trace.h"

#include <boost/thread/locks.hpp>

#include <algorithm>
#include <set>

namespace zebaudiofilterhost
{

namespace
{

constexpr double kLongestLatency = 60.0;             // Seconds
constexpr double kSampleRateForUnsetRate = 192000.0; // Hertz; nothing common is above

std::size_t SizeOf(int count)
{
    return static_cast<std::size_t>(std::max(count, 0));
}

// Channels count modulo 64.
unsigned long long BitsOfFirst(std::size_t channels)
{
    constexpr std::size_t kBits = 64;
    return channels >= kBits ? ~0ULL : (1ULL << channels) - 1;
}

// The element stores are all that the process thread sees, and each index stands for itself: no order is needed.
void Store(int& element, int value)
{
    std::atomic_ref<int>(element).store(value, std::memory_order_relaxed);
}

// Connections that end go away before new ones appear.
void Publish(const std::vector<int>& values, std::vector<int>& target)
{
    if (target.size() != values.size())
        return;
    for (std::size_t i = 0; i < values.size(); ++i)
    {
        if (values[i] == -1)
            Store(target[i], -1);
    }
    for (std::size_t i = 0; i < values.size(); ++i)
        Store(target[i], values[i]);
}

// Writes the slot of each connected plug-in channel into `indices`; a later slot overwrites an earlier one. Plug-in
// channels from `limit` on are ignored. Returns the slots that were written.
std::set<int> CollectConnections(const ChannelMap& map, int limit, std::vector<int>& indices)
{
    std::set<int> connected;
    for (int slot = 0; slot < map.GetNumberOfChannels(); ++slot)
    {
        for (const AudioChannelDescription& description : map.GetChannelLayout(slot))
        {
            const int plugChannel = static_cast<int>(description.GetLabel());
            if (plugChannel < 0 || plugChannel >= limit || SizeOf(plugChannel) >= indices.size())
                continue;
            indices[SizeOf(plugChannel)] = slot;
            connected.insert(slot);
        }
    }
    return connected;
}

} // namespace

// A new state of the four index arrays, of the same sizes as those that are in use.
struct AudioFilter::RenderIndices
{
    std::vector<int> inputs;
    std::vector<int> outputs;
    std::vector<int> delayed;
    std::vector<int> silent;
};

void AudioFilter::BuildChannelMaps()
{
    mSilenceBuffer.resize(SizeOf(mBlockSize));
    mDiscardBuffer.resize(SizeOf(mBlockSize));
    const std::size_t inputs = SizeOf(GetNumberOfInputChannels());
    mPluginInputBits = BitsOfFirst(inputs);
    if (!GetUseChannelMap())
    {
        mInputPointers.resize(inputs);
        return;
    }

    const boost::unique_lock<boost::recursive_mutex> lock(mChannelMapMutex);
    const std::size_t outputs = SizeOf(GetNumberOfOutputChannels());
    const int mainChannels = mMainTargetBus.GetChannelCount();
    mInputChannelIndices.assign(inputs, -1);
    mInputPointers.assign(inputs, mSilenceBuffer.data());
    mDelayLine.reset();
    mDelaying = false;
    mDelayedChannels.assign(SizeOf(mainChannels), -1);
    mSilentChannels.assign(SizeOf(mainChannels), -1);
    mOutputChannelIndices.assign(outputs, -1);
    mOutputPointers.assign(outputs, mDiscardBuffer.data());
    // Without outputs nothing passes by either: the application keeps what it has.
    if (!mOutputBuses.empty() && mainChannels > 0)
    {
        const unsigned int latency = LatencyForDelayLine();
        mDelayLine = new DelayLine(static_cast<unsigned int>(std::max(mBlockSize, 0)), latency,
                                   static_cast<unsigned int>(mainChannels));
        mDelaying = latency > 0;
    }
    UpdateChannelMapArraysForRendering();
}

unsigned int AudioFilter::LatencyForDelayLine() const
{
    const int latency = GetInitialDelay();
    const double sampleRate = mSampleRate > 0.0F ? static_cast<double>(mSampleRate) : kSampleRateForUnsetRate;
    if (latency >= 0 && latency <= kLongestLatency * sampleRate)
        return static_cast<unsigned int>(latency);
    ZEB_TRACE("AudioFilter::BuildChannelMaps", "latency of " << latency << " frames is taken as 0");
    return 0;
}

void AudioFilter::UpdateChannelMapArraysForRendering()
{
    if (!GetUseChannelMap())
        return;
    RenderIndices indices{
        std::vector<int>(mInputChannelIndices.size(), -1), std::vector<int>(mOutputChannelIndices.size(), -1),
        std::vector<int>(mDelayedChannels.size(), -1), std::vector<int>(mSilentChannels.size(), -1)};
    CollectRenderIndices(indices);
    // A block that misses either store finds a complete map, the old one or the new one.
    mRoutedStraight.store(false, std::memory_order_relaxed);
    Publish(indices.inputs, mInputChannelIndices);
    Publish(indices.outputs, mOutputChannelIndices);
    Publish(indices.delayed, mDelayedChannels);
    Publish(indices.silent, mSilentChannels);
    mRoutedStraight.store(IsRoutedStraight(indices), std::memory_order_relaxed);
}

bool AudioFilter::IsRoutedStraight(const RenderIndices& indices) const
{
    const auto isIdentity = [](const std::vector<int>& channels)
    {
        int next = 0;
        return !channels.empty() &&
               std::all_of(channels.begin(), channels.end(), [&next](int channel) { return channel == next++; });
    };
    const auto isEmpty = [](const std::vector<int>& list)
    {
        return list.empty() || list.front() < 0;
    };
    return isIdentity(indices.inputs) && isIdentity(indices.outputs) && isEmpty(indices.delayed) &&
           isEmpty(indices.silent);
}

void AudioFilter::CollectRenderIndices(RenderIndices& indices) const
{
    const int mainChannels = mMainTargetBus.GetChannelCount();
    const int allChannels = mainChannels + mSideChainTargetBus.GetChannelCount();
    // Plug-in channels count only as far as the application has channels, whatever slots the maps name; the side
    // chain widens the inputs alone.
    const std::set<int> fed = CollectConnections(mInputChannelMap, allChannels, indices.inputs);
    const std::set<int> written = CollectConnections(mOutputChannelMap, mainChannels, indices.outputs);

    // A main target that has grown since Resume has channels that neither the lists nor the delay line know.
    const int known = std::min(mainChannels, static_cast<int>(indices.delayed.size()));
    auto delayed = indices.delayed.begin();
    auto silent = indices.silent.begin();
    for (int channel = 0; channel < known; ++channel)
    {
        if (written.contains(channel))
            continue;
        if (fed.contains(channel))
            *silent++ = channel;
        else
            *delayed++ = channel;
    }
}

} // namespace zebaudiofilterhost
