// Writing and reading: runs on the process thread.
#include "utility/DelayLine.h"

#include "foundation/zebaccelerate/FloatBuffer.h"

#include <algorithm>

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

DelayLine::Place DelayLine::FindDelayed(unsigned int frames) const
{
    const std::int64_t ringLength = mRingLength;
    const std::int64_t tail = std::int64_t{mWritePosition} - mDelay;
    const std::int64_t wrap = tail - frames < 0 ? ringLength : 0;
    return {tail - frames + wrap, tail + wrap - ringLength};
}

float** DelayLine::GetDelayedOutput(unsigned int frames)
{
    if (!mValid)
        return nullptr;
    const Place place = FindDelayed(frames);
    if (place.start < 0) // More frames than a block has may begin in front of the ring
        return nullptr;

    for (unsigned int channel = 0; channel < mChannels; ++channel)
    {
        float* samples = mChannelPointers[channel];
        if (place.past > 0)
            Copy(static_cast<unsigned int>(place.past), samples, samples + mRingLength);
        mOutputPointers[channel] = samples + place.start;
    }
    return mOutputPointers.get();
}

bool DelayLine::CopyDelayedOutput(unsigned int channel, unsigned int frames, float* target) const
{
    if (!mValid || channel >= mChannels)
        return false;
    const Place place = FindDelayed(frames);
    if (place.start < 0)
        return false;
    const auto past = static_cast<unsigned int>(std::max<std::int64_t>(place.past, 0));
    const unsigned int head = frames - past;
    Copy(head, mChannelPointers[channel] + place.start, target);
    if (past > 0)
        Copy(past, mChannelPointers[channel], target + head);
    return true;
}

} // namespace zebaudiofilterhost
