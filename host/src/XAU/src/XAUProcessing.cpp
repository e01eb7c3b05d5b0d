// The process thread's part of the filter: sound out of the unit, sound into it, the host's time.

#include "foundation/zebaccelerate/FloatBuffer.h"
#include "foundation/zebcore/Trace.h"
#include "host/src/XAU/src/CallGuarded.h"
#include "host/src/XAU/src/XAUAudioFilter.h"

#include <algorithm>
#include <atomic>

namespace zebaudiofilterhost::xau
{

namespace
{

using zebaccelerate::utility::Copy;
using zebaccelerate::utility::Zero;

template <typename Value, typename From>
void SetIfWanted(Value* output, From value)
{
    if (output)
        *output = static_cast<Value>(value);
}

// The first failure in the life of the process, whichever filter's it is: a unit that fails does so at every block.
void TraceFirstFailure(OSStatus code)
{
    static std::atomic<bool> sTraced = false; // orders nothing
    if (!sTraced.exchange(true, std::memory_order_relaxed))
        ZEB_TRACE_REALTIME("XAUAudioFilter::Process", "AudioUnitRender: " << code);
}

} // namespace

void XAUAudioFilter::Process(float** in, float** out, int frames, ChannelFlags /*inFlags*/, ChannelFlags& outFlags)
{
    outFlags = ChannelFlags();
    if (!mOutputBuffers || !mAUInitialized)
        return; // not resumed since the buses were made, or in vain
    mRenderTime.mRateScalar = 1.0;
    mRenderTime.mFlags =
        kAudioTimeStampSampleTimeValid | kAudioTimeStampHostTimeValid | kAudioTimeStampRateScalarValid;
    for (int offset = 0; offset < frames; offset += kMaxChunk)
        RenderChunk(in, out, offset, std::min(frames - offset, kMaxChunk));
}

void XAUAudioFilter::RenderChunk(float** in, float** out, int offset, int frames)
{
    for (std::size_t channel = 0; channel < mInputPointers.size(); ++channel)
        mInputPointers[channel] = in[channel] + offset;
    // The sample count stands in for the host's time. The counts of a render never are negative or huge.
    mRenderTime.mHostTime = static_cast<UInt64>(std::max(mRenderTime.mSampleTime, 0.0));
    mOutputBuffers->Reset();
    mCurrentInputs = mInputPointers.data();
    mCurrentFrames = frames;
    AudioUnitRenderActionFlags flags = 0;
    const OSStatus result = CallGuarded<AudioUnitRender>(mInstance, &flags, &mRenderTime, 0,
                                                         static_cast<UInt32>(frames), &mOutputBuffers->Get());
    if (result == noErr)
        CopyOutputs(out, offset, frames);
    else
        TraceFirstFailure(result);
    mCurrentInputs = nullptr;
    mRenderTime.mSampleTime += frames;
}

// A unit that gives no memory for a channel leaves it as it is.
void XAUAudioFilter::CopyOutputs(float** out, int offset, int frames)
{
    const AudioBuffer* buffers = mOutputBuffers->Get().mBuffers;
    for (std::size_t channel = 0; channel < mOutputBuffers->mCount; ++channel)
    {
        if (buffers[channel].mData)
            Copy(static_cast<unsigned int>(frames), static_cast<const float*>(buffers[channel].mData),
                 out[channel] + offset);
    }
}

OSStatus XAUAudioFilter::RenderCallback(AudioUnitRenderActionFlags* /*flags*/, const AudioTimeStamp* /*timeStamp*/,
                                        UInt32 bus, UInt32 frames, AudioBufferList* ioData)
{
    if (bus >= mBusOffsets.size() || !mCurrentInputs || !ioData)
        return noErr;
    const std::size_t inputs = mInputPointers.size();
    const std::size_t count = std::min<std::size_t>(ioData->mNumberBuffers, inputs);
    const UInt32 available = std::min(frames, static_cast<UInt32>(mCurrentFrames));
    for (std::size_t index = 0; index < count; ++index)
    {
        AudioBuffer& buffer = ioData->mBuffers[index];
        buffer.mNumberChannels = 1;
        buffer.mDataByteSize = frames * static_cast<UInt32>(sizeof(float));
        if (!buffer.mData)
        {
            // Without the bus's offset, on purpose: a later bus reads the first channels here.
            LendInput(index, frames, buffer);
            continue;
        }
        auto* target = static_cast<float*>(buffer.mData);
        const std::size_t channel = mBusOffsets[bus] + index;
        const UInt32 copied = channel < inputs ? available : 0; // the rest is silent
        Copy(copied, channel < inputs ? mCurrentInputs[channel] : nullptr, target);
        Zero(frames - copied, target + copied);
    }
    return noErr;
}

// Memory for as many frames as the buffer says: the input itself, or, for a unit that asks for more than it was asked
// for, a copy with silence behind it. Beyond the largest chunk there is none.
void XAUAudioFilter::LendInput(std::size_t channel, UInt32 frames, AudioBuffer& buffer)
{
    const auto available = static_cast<UInt32>(mCurrentFrames);
    if (frames <= available)
    {
        buffer.mData = mCurrentInputs[channel];
        return;
    }
    const UInt32 lent = std::min(frames, static_cast<UInt32>(kMaxChunk));
    float* const memory = mInputScratch.data() + channel * static_cast<std::size_t>(kMaxChunk);
    Copy(available, mCurrentInputs[channel], memory);
    Zero(lent - available, memory + available);
    buffer.mData = memory;
    buffer.mDataByteSize = lent * static_cast<UInt32>(sizeof(float));
}

OSStatus XAUAudioFilter::StaticRenderCallback(void* refCon, AudioUnitRenderActionFlags* flags,
                                              const AudioTimeStamp* timeStamp, UInt32 bus, UInt32 frames,
                                              AudioBufferList* ioData)
{
    return static_cast<XAUAudioFilter*>(refCon)->RenderCallback(flags, timeStamp, bus, frames, ioData);
}

// False without a host. What the host answers is not looked at: it leaves the zeros where it knows nothing.
bool XAUAudioFilter::ReadTempo(utility::Tempo& tempo) const
{
    const IAudioFilterHost* host = GetAudioFilterHost();
    if (host)
        host->GetTempo(tempo);
    return host != nullptr;
}

// The first beat is 1.
OSStatus XAUAudioFilter::GetBeatAndTempo(void* hostUserData, Float64* outBeat, Float64* outTempo)
{
    constexpr double kSecondsPerMinute = 60.0;
    const auto& filter = *static_cast<const XAUAudioFilter*>(hostUserData);
    utility::Tempo tempo;
    if (!filter.ReadTempo(tempo))
        return noErr;
    const auto offset = static_cast<float>(filter.mCurrentOffset.load(std::memory_order_relaxed));
    const auto seconds = static_cast<double>(offset / filter.mSampleRate);
    SetIfWanted(outBeat, seconds * tempo.mTempo / kSecondsPerMinute + 1.0);
    SetIfWanted(outTempo, tempo.mTempo);
    return noErr;
}

OSStatus XAUAudioFilter::GetMusicalTimeLocation(void* hostUserData, UInt32* outDelta, Float32* outNumerator,
                                                UInt32* outDenominator, Float64* outDownBeat)
{
    utility::Tempo tempo;
    static_cast<const XAUAudioFilter*>(hostUserData)->ReadTempo(tempo);
    SetIfWanted(outDelta, 0);
    SetIfWanted(outNumerator, tempo.mNumerator);
    SetIfWanted(outDenominator, tempo.mDenominator);
    SetIfWanted(outDownBeat, 0.0);
    return noErr;
}

// Every answer says that something has changed, on purpose: units look at it when they start to play.
OSStatus XAUAudioFilter::GetTransportState(void* hostUserData, Boolean* outPlaying, Boolean* outChanged,
                                           Float64* outSample, Boolean* outCycling, Float64* outCycleStart,
                                           Float64* outCycleEnd)
{
    const auto& filter = *static_cast<const XAUAudioFilter*>(hostUserData);
    SetIfWanted(outPlaying, filter.mSuspended.load(std::memory_order_relaxed) ? 0 : 1);
    SetIfWanted(outChanged, 1);
    SetIfWanted(outSample, filter.mCurrentOffset.load(std::memory_order_relaxed));
    SetIfWanted(outCycling, 0);
    SetIfWanted(outCycleStart, 0.0);
    SetIfWanted(outCycleEnd, 0.0);
    return noErr;
}

} // namespace zebaudiofilterhost::xau
