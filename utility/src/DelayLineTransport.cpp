// Writing and reading: runs on the process thread.
#include "utility/DelayLine.h"

#include "foundation/zebaccelerate/FloatBuffer.h"

namespace zebaudiofilterhost
{

using zebaccelerate::utility::Copy;

void DelayLine::WriteData(float** channelData, unsigned int frames)
{
    if (!mValid || frames > mBufferSize)
        return;
    if (mFilled + frames <= mRingLength)
    {
        Append(channelData, frames);
        mFilled += frames;
        return;
    }

    // The position may come to stand at the ring's end: the next block then wraps as a whole.
    if (mWritePosition + frames <= mRingLength)
        Append(channelData, frames);
    else
        AppendWrapped(channelData, frames);
    mFilled = mRingLength;
}

void DelayLine::Append(float** channelData, unsigned int frames)
{
    for (unsigned int channel = 0; channel < mChannels; ++channel)
        Copy(frames, channelData[channel], mChannelPointers[channel] + mWritePosition);
    mWritePosition += frames;
}

void DelayLine::AppendWrapped(float** channelData, unsigned int frames)
{
    const unsigned int over = mWritePosition + frames - mRingLength;
    const unsigned int head = frames - over;
    for (unsigned int channel = 0; channel < mChannels; ++channel)
    {
        Copy(head, channelData[channel], mChannelPointers[channel] + mWritePosition);
        Copy(over, channelData[channel] + head, mChannelPointers[channel]);
    }
    mWritePosition = over;
}

float** DelayLine::GetDelayedOutput(unsigned int frames)
{
    if (!mValid || frames > mBufferSize) // A larger block would begin in front of the ring
        return nullptr;

    const int ringLength = static_cast<int>(mRingLength);
    const int tail = static_cast<int>(mWritePosition) - static_cast<int>(mDelay);
    const int wrap = tail - static_cast<int>(frames) < 0 ? ringLength : 0;
    const int start = tail - static_cast<int>(frames) + wrap;
    const int past = tail + wrap - ringLength; // Frames that lie at the ring's start and belong behind its end

    for (unsigned int channel = 0; channel < mChannels; ++channel)
    {
        float* samples = mChannelPointers[channel];
        if (past > 0)
            Copy(static_cast<unsigned int>(past), samples, samples + ringLength);
        mOutputPointers[channel] = samples + start;
    }
    return mOutputPointers.get();
}

} // namespace zebaudiofilterhost
