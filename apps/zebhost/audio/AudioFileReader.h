#pragma once

#include "audio/SampleFormat.h"

#include <foundation/zebmediatypes/ChannelLayout.h>

#include <sndfile.h>

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace zebhost
{

struct SoundFileCloser
{
    void operator()(SNDFILE* file) const { sf_close(file); }
};
using SoundFile = std::unique_ptr<SNDFILE, SoundFileCloser>;

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
    SampleFormat Format() const { return SampleFormatOf(mInfo.format); }
    // The speaker positions that the file tells, or the usual ones.
    const zebmediatypes::ChannelLayout& Layout() const { return mLayout; }
    // libsndfile's numbers for speaker positions; empty if the file tells none.
    const std::vector<int>& ChannelCodes() const { return mChannelCodes; }
    // Title, artist and the like, by libsndfile's numbers.
    const std::map<int, std::string>& Texts() const { return mTexts; }

    // Fills `frames` floats of each channel, with zeros behind the file's end; returns how many came from the file.
    int Read(float* const* channels, int frames);

private:
    void ReadLayout();
    void ReadTexts();
    sf_count_t ReadInterleaved(int frames);

    std::string mPath;
    SF_INFO mInfo{};
    SoundFile mFile;
    zebmediatypes::ChannelLayout mLayout;
    std::vector<int> mChannelCodes;
    std::map<int, std::string> mTexts;
    std::vector<float> mInterleaved;
    std::vector<int> mIntegers;
};

} // namespace zebhost
