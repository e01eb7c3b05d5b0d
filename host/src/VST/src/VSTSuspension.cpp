// The filter's way from suspended to running and back, and what the application sets while it is suspended.

#include "host/src/VST/src/VSTAudioFilter.h"

#include <algorithm>

namespace zebaudiofilterhost::vst
{

namespace
{

int ChannelsOfFirst(const std::vector<AudioFilterBusDescription>& buses)
{
    return buses.empty() ? 0 : buses.front().GetChannelCount();
}

} // namespace

void VSTAudioFilter::SetBlockSize(int blockSize)
{
    AudioFilter::SetBlockSize(blockSize);
    Dispatcher(effSetBlockSize, 0, blockSize, nullptr, 0.0F);
}

// Less than the plug-in was told when it was opened, and on purpose.
int VSTAudioFilter::GetMaxProcessingBlockSize() const
{
    return 1024;
}

// Read each time, so that a latency that has changed is seen without notice.
int VSTAudioFilter::GetInitialDelay() const
{
    return GetEffect() ? GetEffect()->initialDelay : 0;
}

void VSTAudioFilter::Suspend()
{
    MarkTransport(false);
    Dispatcher(effStopProcess, 0, 0, nullptr, 0.0F);
    Dispatcher(effMainsChanged, 0, 0, nullptr, 0.0F);
    AudioFilter::Suspend();
}

void VSTAudioFilter::Resume()
{
    AudioFilter::Resume();
    if (mMonoThroughStereo)
        mScratchOutput.resize(static_cast<std::size_t>(std::max(mBlockSize, 0)));
    PreparePins();
    MarkTransport(true);
    Dispatcher(effMainsChanged, 0, 1, nullptr, 0.0F);
    Dispatcher(effStartProcess, 0, 0, nullptr, 0.0F);
    RewindTimeInfo();
}

void VSTAudioFilter::PreparePins()
{
    // Each count stands for itself: no order is needed.
    mFirstInputBusChannels.store(ChannelsOfFirst(GetInputBuses()), std::memory_order_relaxed);
    mFirstOutputBusChannels.store(ChannelsOfFirst(GetOutputBuses()), std::memory_order_relaxed);
    mPins.Prepare(GetNumberOfInputChannels(), GetNumberOfOutputChannels(), mBlockSize);
}

} // namespace zebaudiofilterhost::vst
