// Plain storing and reading.
#include "audiofilter/AudioFilter.h"

namespace zebaudiofilterhost
{

void AudioFilter::SetAudioFilterHost(IAudioFilterHost* host)
{
    mHost.store(host, std::memory_order_release); // With what the application has written to the host before
}

IAudioFilterHost* AudioFilter::GetAudioFilterHost() const
{
    return mHost.load(std::memory_order_acquire);
}

void AudioFilter::SetSampleRate(float sampleRate)
{
    mSampleRate = sampleRate;
}

void AudioFilter::SetBlockSize(int frames)
{
    if (mBlockSize != frames)
        mBlockSize = frames;
}

void AudioFilter::SetSelectionLeft(double position)
{
    mSelectionLeft = position;
}

double AudioFilter::GetSelectionLeft() const
{
    return mSelectionLeft;
}

void AudioFilter::SetCurrentDuration(double duration)
{
    mCurrentDuration = duration;
}

double AudioFilter::GetCurrentDuration() const
{
    return mCurrentDuration;
}

void AudioFilter::SetRenderingContext(RenderingContext context)
{
    mRenderingContext = context;
}

UTF16String AudioFilter::GetID() const
{
    return mFilterID;
}

UTF16String AudioFilter::GetDisplayName() const
{
    return mDisplayName;
}

void AudioFilter::SetDisplayName(const UTF16String& displayName)
{
    mDisplayName = displayName;
}

bool AudioFilter::GetHasHighLatency() const
{
    return mHasHighLatency.load(std::memory_order_relaxed);
}

void AudioFilter::SetHasHighLatency(bool highLatency)
{
    mHasHighLatency.store(highLatency, std::memory_order_relaxed);
}

bool AudioFilter::GetHasHighCPU() const
{
    return mHasHighCPU.load(std::memory_order_relaxed);
}

void AudioFilter::SetHasHighCPU(bool highCPU)
{
    mHasHighCPU.store(highCPU, std::memory_order_relaxed);
}

bool AudioFilter::GetEditorVisible() const
{
    return mEditorVisible.load(std::memory_order_relaxed);
}

void AudioFilter::SetEditorVisible(bool visible)
{
    mEditorVisible.store(visible, std::memory_order_relaxed);
}

zebcore::geom::RectT<int> AudioFilter::GetEditorRect() const
{
    return mEditorRect;
}

void AudioFilter::SetEditorRect(const zebcore::geom::RectT<int>& rect)
{
    mEditorRect = rect;
}

bool AudioFilter::IsLoadingSettings() const
{
    return mLoadingSettings.load(std::memory_order_relaxed);
}

const std::pair<UTF16String, bool>& AudioFilter::GetPresetNameAndDirtyState() const
{
    return mPresetNameAndDirtyState;
}

void AudioFilter::SetPresetNameAndDirtyState(const std::pair<UTF16String, bool>& state)
{
    mPresetNameAndDirtyState = state;
}

} // namespace zebaudiofilterhost
