// What changes between two runs of the filter: sizes, rates, buffers.

#include "host/src/XAU/src/CallGuarded.h"
#include "host/src/XAU/src/XAUAudioFilter.h"

#include <algorithm>

namespace zebaudiofilterhost::xau
{

namespace
{

constexpr std::size_t kListHeader = offsetof(AudioBufferList, mBuffers);

} // namespace

XAUAudioFilter::BufferList::BufferList(std::size_t count)
    : mCount(count)
    , mMemory(new std::byte[std::max(sizeof(AudioBufferList), kListHeader + count * sizeof(AudioBuffer))]())
{
    Reset();
}

AudioBufferList& XAUAudioFilter::BufferList::Get() const
{
    return *reinterpret_cast<AudioBufferList*>(mMemory.get());
}

// NOLINTNEXTLINE(readability-make-member-function-const): changes the list that it owns
void XAUAudioFilter::BufferList::Reset()
{
    AudioBufferList& list = Get();
    list.mNumberBuffers = static_cast<UInt32>(mCount);
    for (std::size_t index = 0; index < mCount; ++index)
        list.mBuffers[index] = {1, 0, nullptr};
}

void XAUAudioFilter::SetSampleRate(float sampleRate)
{
    if (sampleRate == mSampleRate)
        return;
    AudioFilter::SetSampleRate(sampleRate);
    const bool wasInitialized = mAUInitialized;
    UninitializeAU();
    for (const AudioUnitScope scope : {kAudioUnitScope_Input, kAudioUnitScope_Output})
    {
        const UInt32 count = GetElementCount(scope);
        for (AudioUnitElement element = 0; element < count; ++element)
            SetSampleRate(scope, element, static_cast<double>(sampleRate));
    }
    if (wasInitialized)
        InitializeAU();
}

OSStatus XAUAudioFilter::SetSampleRate(AudioUnitScope scope, AudioUnitElement element, double rate)
{
    AudioStreamBasicDescription format = {};
    const OSStatus result = GetStreamFormat(scope, element, format);
    if (result != noErr)
        return result;
    format.mSampleRate = rate;
    return SetStreamFormat(scope, element, format);
}

void XAUAudioFilter::SetBlockSize(int blockSize)
{
    if (blockSize == mBlockSize)
        return;
    AudioFilter::SetBlockSize(blockSize);
    const bool wasInitialized = mAUInitialized;
    UninitializeAU();
    const auto frames = static_cast<UInt32>(std::clamp(blockSize, 0, kMaxChunk));
    DumpResultIfFailed(CallGuarded<AudioUnitSetProperty>(mInstance, kAudioUnitProperty_MaximumFramesPerSlice,
                                                         kAudioUnitScope_Global, 0, &frames, sizeof(frames)),
                       "AudioUnitSetProperty(kAudioUnitProperty_MaximumFramesPerSlice)");
    if (wasInitialized)
        InitializeAU();
}

void XAUAudioFilter::SetCurrentOffset(long long offset)
{
    if (mCurrentOffset.exchange(offset, std::memory_order_relaxed) != offset) // says nothing about other data
        mRenderTime.mSampleTime = static_cast<double>(offset);
}

void XAUAudioFilter::Resume()
{
    AudioFilter::Resume();
    UpdateRenderCallbacks();
    InitializeAU();
    mOutputBuffers = std::make_unique<BufferList>(mOutputChannels);
    mInputPointers.resize(mInputChannels);
    mInputScratch.resize(mInputChannels * static_cast<std::size_t>(kMaxChunk));
    mRenderTime.mSampleTime = 0.0;
    const UInt32 count = GetElementCount(kAudioUnitScope_Input);
    for (AudioUnitElement element = 0; element < count; ++element)
        CallGuarded<AudioUnitReset>(mInstance, kAudioUnitScope_Global, element);
}

// The unit stays initialised: GetTransportState tells it that nothing plays.
void XAUAudioFilter::Suspend()
{
    AudioFilter::Suspend();
}

} // namespace zebaudiofilterhost::xau
