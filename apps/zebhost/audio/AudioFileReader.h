#pragma once

#include "audio/SampleFormat.h"
#include "audio/SampleMeter.h"
#include "audio/SoundFile.h"

#include <foundation/zebmediatypes/ChannelLayout.h>

#include <sndfile.h>

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace zebhost
{

// A sound file as rows of floats. Integer samples of up to 24 bits become floats that AudioFileWriter turns back into
// the same integers.
class AudioFileReader
{
public:
    // Throws a Failure if it cannot be read.
    explicit AudioFileReader(const std::string& path);

    const std::string& Path() const { return mPath; }
    int Channels() const { return mInfo.channels; }
    int SampleRate() const { return mInfo.samplerate; }
    // By the file's head; streams without one say a huge number.
    std::int64_t Frames() const { return mInfo.frames; }
    // Whether Frames is to be relied on.
    bool KnowsFrames() const { return mInfo.seekable == SF_TRUE && mInfo.frames != SF_COUNT_MAX; }
    // Whether the file seems to end before its time, though all that there is can be read.
    bool MayBeCutOff() const;
    SampleFormat Format() const { return SampleFormatOf(mInfo.format); }
    // The speaker positions that the file tells, or the usual ones.
    const zebmediatypes::ChannelLayout& Layout() const { return mLayout; }
    // libsndfile's numbers for speaker positions; empty if the file tells none.
    const std::vector<int>& ChannelCodes() const { return mChannelCodes; }
    // Title, artist and the like, by libsndfile's numbers.
    const std::map<int, std::string>& Texts() const { return mTexts; }

    // Fills `frames` floats of each channel, with zeros behind the file's end and for samples that are no number;
    // returns how many came from the file. Throws a Failure where the file ends before its time, or is damaged.
    int Read(float* const* channels, int frames);
    // Of what has been read.
    const SampleMeter& Meter() const { return mMeter; }

private:
    void ReadLayout();
    void ReadTexts();
    sf_count_t ReadInterleaved(int frames);
    void CheckEnd() const;

    std::string mPath;
    SF_INFO mInfo{};
    SoundFile mFile;
    zebmediatypes::ChannelLayout mLayout;
    std::vector<int> mChannelCodes;
    std::map<int, std::string> mTexts;
    std::vector<float> mInterleaved;
    std::vector<int> mIntegers;
    SampleMeter mMeter;
    std::int64_t mFramesRead = 0;
};

} // namespace zebhost
