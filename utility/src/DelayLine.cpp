#include "utility/DelayLine.h"

#include "foundation/zebaccelerate/FloatBuffer.h"

#include <cstdint>
#include <limits>
#include <new>

namespace zebaudiofilterhost
{

namespace
{

// 0 if the sum, or anything made of it, would not fit the vector library's counts.
unsigned int CheckedSampleCount(std::uint64_t framesPerChannel, unsigned int channels)
{
    constexpr std::uint64_t kMost = std::numeric_limits<std::int32_t>::max();
    if (framesPerChannel > kMost || framesPerChannel * channels > kMost)
        return 0;
    return static_cast<unsigned int>(framesPerChannel * channels);
}

} // namespace

void DelayLine::FreeSamples::operator()(float* samples) const noexcept
{
    zebaccelerate::utility::Free(samples);
}

DelayLine::DelayLine() = default;

DelayLine::DelayLine(unsigned int bufferSize, unsigned int delay, unsigned int channels)
    : mDelay(delay), mRingLength(delay + bufferSize), mBufferSize(bufferSize), mChannels(channels)
{
    AllocateAudioBuffer();
}

DelayLine::~DelayLine()
{
    DeleteAudioBuffer();
}

bool DelayLine::SetBufferSize(unsigned int bufferSize)
{
    if (mValid && bufferSize == mBufferSize)
        return true;
    mBufferSize = bufferSize;
    mRingLength = mDelay + mBufferSize;
    return AllocateAudioBuffer();
}

bool DelayLine::SetDelay(unsigned int delay)
{
    mDelay = delay;
    mRingLength = mDelay + mBufferSize;
    return AllocateAudioBuffer();
}

void DelayLine::Reset(bool clear)
{
    mWritePosition = 0;
    mFilled = 0;
    if (clear && mValid)
        zebaccelerate::utility::Zero(mAllocatedLength * mChannels, mSamples.get());
}

void DelayLine::DeleteAudioBuffer()
{
    mValid = false;
    mSamples.reset();
    mChannelPointers.reset();
    mOutputPointers.reset();
    mFilled = 0;
    mWritePosition = 0;
}

bool DelayLine::AllocateAudioBuffer()
{
    DeleteAudioBuffer();

    const std::uint64_t length = 2 * std::uint64_t{mBufferSize} + mDelay;
    const unsigned int sampleCount = CheckedSampleCount(length, mChannels);
    if (sampleCount == 0 && length * mChannels != 0)
        return false;
    mAllocatedLength = static_cast<unsigned int>(length);

    mSamples.reset(zebaccelerate::utility::Malloc_Float(sampleCount));
    mChannelPointers.reset(new (std::nothrow) float*[mChannels]);
    mOutputPointers.reset(new (std::nothrow) float*[mChannels]);
    if (mSamples == nullptr || mChannelPointers == nullptr || mOutputPointers == nullptr)
    {
        DeleteAudioBuffer();
        return false;
    }

    for (unsigned int channel = 0; channel < mChannels; ++channel)
        mChannelPointers[channel] = mOutputPointers[channel] =
            mSamples.get() + std::size_t{channel} * mAllocatedLength;
    zebaccelerate::utility::Zero(sampleCount, mSamples.get());
    mValid = true;
    return true;
}

} // namespace zebaudiofilterhost
