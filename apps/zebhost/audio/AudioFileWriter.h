#pragma once

#include "audio/AudioFileReader.h"
#include "audio/OutputFile.h"
#include "audio/OutputStream.h"
#include "audio/SampleMeter.h"

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

    // Throws a Failure when there is no room for them, on the disk or in a file of this kind.
    void Write(const float* const* channels, int firstFrame, int frames);
    // Completes the file and gives it its name.
    void Finish();

    std::int64_t Frames() const { return mFrames; }
    // Samples that were beyond what the format holds.
    std::int64_t ClippedSamples() const { return mClipped; }
    // Of all samples as they came.
    const SampleMeter& Meter() const { return mMeter; }

private:
    void CheckLength(std::int64_t frames) const;
    void CopyHead(const AudioFileReader& like);
    int ToInteger(float value);
    // Throws the Failure for `action`, by what is known of its reason.
    [[noreturn]] void Refuse(const std::string& action) const;
    void Count(std::int64_t written, int frames);

    OutputFile& mOutput;
    SampleFormat mFormat;
    int mChannels;
    OutputStream mStream;
    SoundFile mFile;
    std::vector<float> mInterleaved;
    std::vector<int> mIntegers;
    std::int64_t mFrames = 0;
    std::int64_t mClipped = 0;
    SampleMeter mMeter;
};

} // namespace zebhost
