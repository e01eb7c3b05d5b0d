// A multichannel delay by a fixed number of frames.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/RefCountedObject.h"

#include <cstdint>
#include <memory>

namespace zebaudiofilterhost
{

/// A ring of float samples that gives back what was written a fixed number of frames ago.
///
/// Reading hands out pointers straight into the ring; room of one block past its end keeps each block contiguous.
/// Held by boost::intrusive_ptr, used by one thread at a time.
class ZEB_EXPORT DelayLine : public virtual zebcore::utility::RefCountedObject
{
public:
    /// An invalid line: no storage, all sizes 0. [main]
    DelayLine();

    /// bufferSize: frames of the largest block; delay: frames. A failed allocation leaves the line invalid. [main]
    DelayLine(unsigned int bufferSize, unsigned int delay, unsigned int channels);

    ~DelayLine() override;

    DelayLine(const DelayLine&) = delete;
    DelayLine& operator=(const DelayLine&) = delete;

    /// False on an allocation failure, which leaves the line invalid. The same size keeps the content of a valid
    /// line; any other empties it. [main, suspended]
    bool SetBufferSize(unsigned int bufferSize);

    /// False on an allocation failure, which leaves the line invalid. Always empties the line. [main, suspended]
    bool SetDelay(unsigned int delay);

    /// Starts anew; with `clear` false old samples stay in storage and can reappear. [main, suspended]
    void Reset(bool clear);

    /// Frees the storage and makes the line invalid. [main, suspended]
    void DeleteAudioBuffer();

    /// Writes one block of every channel. Nothing happens on an invalid line, or with more frames than the buffer
    /// size. Does not allocate. [process]
    void WriteData(float** channelData, unsigned int frames);

    /// One pointer a channel to `frames` delayed samples, for the block just written. Null on an invalid line, or if
    /// so many frames reach back beyond what the line keeps. Valid until the next operation. Does not allocate.
    /// [process]
    float** GetDelayedOutput(unsigned int frames);

    /// Copies one channel's delayed samples for the block just written, without the detour over the room past the
    /// ring's end. False, with nothing written, on an invalid line, without such a channel, or if so many frames
    /// reach back beyond what the line keeps. Does not allocate. [process]
    bool CopyDelayedOutput(unsigned int channel, unsigned int frames, float* target) const;

private:
    /// Where a block of so many frames, the last that was written, lies in the ring.
    struct Place
    {
        std::int64_t start;
        std::int64_t past; // Frames that lie at the ring's start and belong behind its end; may be negative
    };
    Place FindDelayed(unsigned int frames) const;

    struct FreeSamples
    {
        void operator()(float* samples) const noexcept;
    };

    bool AllocateAudioBuffer();
    void Append(float** channelData, unsigned int frames);
    void AppendWrapped(float** channelData, unsigned int frames);

    unsigned int mDelay = 0;
    unsigned int mWritePosition = 0;
    unsigned int mRingLength = 0;
    unsigned int mAllocatedLength = 0;
    std::unique_ptr<float*[]> mOutputPointers;
    unsigned int mBufferSize = 0;
    unsigned int mFilled = 0;
    bool mValid = false;
    std::unique_ptr<float[], FreeSamples> mSamples;
    std::unique_ptr<float*[]> mChannelPointers;
    unsigned int mChannels = 0;
};

} // namespace zebaudiofilterhost
