#include "audio/AudioFileWriter.h"

#include "cli/Failure.h"
#include "cli/WantOfRoom.h"

#include <algorithm>
#include <cmath>
#include <cstring>

namespace zebhost
{

AudioFileWriter::AudioFileWriter(OutputFile& output, const SampleFormat& format, const AudioFileReader& like)
    : mOutput(output), mFormat(format), mChannels(like.Channels()), mStream(output.Descriptor())
{
    if (like.KnowsFrames())
    {
        CheckLength(like.Frames());
    }
    SF_INFO info{};
    info.channels = mChannels;
    info.samplerate = like.SampleRate();
    info.format = format.Code();
    mFile = mStream.Open(info);
    if (mFile == nullptr)
    {
        Refuse("cannot be written");
    }
    CopyHead(like);
}

void AudioFileWriter::CheckLength(std::int64_t frames) const
{
    if (frames > mFormat.MostFrames(mChannels))
    {
        throw Failure(ExitCode::FileTrouble,
                      mOutput.Path() + " would be longer than its kind of file can be: choose .wav, .caf or .w64");
    }
}

void AudioFileWriter::CopyHead(const AudioFileReader& like)
{
    sf_command(mFile.get(), SFC_SET_CLIPPING, nullptr, SF_TRUE);
    std::vector<int> codes = like.ChannelCodes();
    if (!codes.empty())
    {
        sf_command(mFile.get(), SFC_SET_CHANNEL_MAP_INFO, codes.data(), static_cast<int>(codes.size() * sizeof(int)));
    }
    for (const auto& [kind, text] : like.Texts())
    {
        sf_set_string(mFile.get(), kind, text.c_str());
    }
}

void AudioFileWriter::Write(const float* const* channels, int firstFrame, int frames)
{
    CheckLength(mFrames + frames);
    const auto rows = static_cast<std::size_t>(mChannels);
    const auto count = static_cast<std::size_t>(frames);
    mInterleaved.resize(rows * count);
    for (std::size_t row = 0; row < rows; ++row)
    {
        for (std::size_t frame = 0; frame < count; ++frame)
        {
            mInterleaved[frame * rows + row] = channels[row][static_cast<std::size_t>(firstFrame) + frame];
        }
    }
    mMeter.Take(mInterleaved);
    if (mFormat.IntegerBits() == 0)
    {
        Count(sf_writef_float(mFile.get(), mInterleaved.data(), frames), frames);
        return;
    }
    mIntegers.resize(mInterleaved.size());
    std::transform(mInterleaved.begin(), mInterleaved.end(), mIntegers.begin(),
                   [this](float value) { return ToInteger(value); });
    Count(sf_writef_int(mFile.get(), mIntegers.data(), frames), frames);
}

// libsndfile takes integers of any size at the top of 32 bits.
int AudioFileWriter::ToInteger(float value)
{
    const int bits = mFormat.IntegerBits();
    const double full = std::ldexp(1.0, bits - 1);
    const double rounded = std::nearbyint(static_cast<double>(value) * full);
    // A float of exactly 1 is one step too many, which nobody means by clipping.
    mClipped += rounded > full || rounded < -full ? 1 : 0;
    const double bounded = std::clamp(rounded, -full, full - 1);
    return static_cast<int>(static_cast<std::int64_t>(bounded) * (std::int64_t{1} << (32 - bits)));
}

void AudioFileWriter::Refuse(const std::string& action) const
{
    const int error = mStream.Error();
    const std::string reason = error != 0 ? std::strerror(error) : SoundFileError(mFile.get());
    const bool isFull = error == 0 || IsWantOfRoom(error);
    throw Failure(ExitCode::FileTrouble, mOutput.Path() + " " + action + (reason.empty() ? "" : " (" + reason + ")") +
                                             ": " + (isFull ? "make room on the disk" : "choose another folder"));
}

void AudioFileWriter::Count(std::int64_t written, int frames)
{
    if (written != frames || mStream.Error() != 0)
    {
        Refuse("could not be written to the end");
    }
    mFrames += written;
}

// Much of a compressed file is written here.
void AudioFileWriter::Finish()
{
    SNDFILE* file = mFile.release();
    if (sf_close(file) != 0 || mStream.Error() != 0)
    {
        Refuse("could not be completed");
    }
    mOutput.Commit();
}

} // namespace zebhost
