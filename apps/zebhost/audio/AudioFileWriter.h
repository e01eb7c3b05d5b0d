#pragma once

#include "audio/AudioFileReader.h"
#include "audio/OutputFile.h"

#include <cstdint>
#include <string>
#include <vector>

namespace zebhost
{

// Rows of floats as a sound file. Integers are rounded to the nearest, without dither, so that floats which came from
// integers of the same size give them back.
class AudioFileWriter
{
public:
    // Channels, rate, speaker positions and texts are those of `like`. `output` outlives this. Throws a Failure if it
    // cannot be written.
    AudioFileWriter(OutputFile& output, const SampleFormat& format, const AudioFileReader& like);

    void Write(const float* const* channels, int firstFrame, int frames);
    // Completes the file and gives it its name.
    void Finish();

    std::int64_t Frames() const { return mFrames; }
    // Samples that were beyond what the format holds.
    std::int64_t ClippedSamples() const { return mClipped; }
    // Samples that were infinite or no number, and became 0.
    std::int64_t BrokenSamples() const { return mBroken; }
    float Peak() const { return mPeak; }

private:
    void CopyHead(const AudioFileReader& like);
    void Measure();
    int ToInteger(float value);
    void Count(std::int64_t written, int frames);

    OutputFile& mOutput;
    SampleFormat mFormat;
    int mChannels;
    SoundFile mFile;
    std::vector<float> mInterleaved;
    std::vector<int> mIntegers;
    std::int64_t mFrames = 0;
    std::int64_t mClipped = 0;
    std::int64_t mBroken = 0;
    float mPeak = 0;
};

} // namespace zebhost
