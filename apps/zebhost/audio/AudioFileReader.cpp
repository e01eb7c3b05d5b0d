#include "audio/AudioFileReader.h"

#include "audio/ChannelNames.h"
#include "cli/Failure.h"
#include "cli/StartFolder.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <filesystem>
#include <utility>

namespace zebhost
{

using namespace zebmediatypes;

namespace
{

constexpr float kIntegerScale = 1.0F / 2147483648.0F;

constexpr std::array<std::pair<int, AudioChannelLabel>, 21> kLabels = {{
    {SF_CHANNEL_MAP_MONO, kAudioChannelLabel_None},
    {SF_CHANNEL_MAP_LEFT, kAudioChannelLabel_Left},
    {SF_CHANNEL_MAP_RIGHT, kAudioChannelLabel_Right},
    {SF_CHANNEL_MAP_CENTER, kAudioChannelLabel_Center},
    {SF_CHANNEL_MAP_FRONT_LEFT, kAudioChannelLabel_Left},
    {SF_CHANNEL_MAP_FRONT_RIGHT, kAudioChannelLabel_Right},
    {SF_CHANNEL_MAP_FRONT_CENTER, kAudioChannelLabel_Center},
    {SF_CHANNEL_MAP_REAR_CENTER, kAudioChannelLabel_CenterSurround},
    {SF_CHANNEL_MAP_REAR_LEFT, kAudioChannelLabel_LeftSurround},
    {SF_CHANNEL_MAP_REAR_RIGHT, kAudioChannelLabel_RightSurround},
    {SF_CHANNEL_MAP_LFE, kAudioChannelLabel_LFE},
    {SF_CHANNEL_MAP_FRONT_LEFT_OF_CENTER, kAudioChannelLabel_LeftCenter},
    {SF_CHANNEL_MAP_FRONT_RIGHT_OF_CENTER, kAudioChannelLabel_RightCenter},
    {SF_CHANNEL_MAP_SIDE_LEFT, kAudioChannelLabel_SideLeft},
    {SF_CHANNEL_MAP_SIDE_RIGHT, kAudioChannelLabel_SideRight},
    {SF_CHANNEL_MAP_TOP_CENTER, kAudioChannelLabel_TopCenter},
    {SF_CHANNEL_MAP_TOP_FRONT_LEFT, kAudioChannelLabel_TopFrontLeft},
    {SF_CHANNEL_MAP_TOP_FRONT_RIGHT, kAudioChannelLabel_TopFrontRight},
    {SF_CHANNEL_MAP_TOP_FRONT_CENTER, kAudioChannelLabel_TopFrontCenter},
    {SF_CHANNEL_MAP_TOP_REAR_LEFT, kAudioChannelLabel_TopRearLeft},
    {SF_CHANNEL_MAP_TOP_REAR_RIGHT, kAudioChannelLabel_TopRearRight},
}};

AudioChannelLabel LabelOf(int code)
{
    const auto found =
        std::find_if(kLabels.begin(), kLabels.end(), [code](const auto& each) { return each.first == code; });
    return found == kLabels.end() ? kAudioChannelLabel_None : found->second;
}

// Surround channels beside the listener are the only ones where no others stand behind.
void NameSidesAsSurround(ChannelLayout& layout)
{
    const auto has = [&layout](AudioChannelLabel label)
    {
        return std::find(layout.begin(), layout.end(), AudioChannelDescription(label)) != layout.end();
    };
    if (has(kAudioChannelLabel_LeftSurround) || !has(kAudioChannelLabel_SideLeft))
    {
        return;
    }
    std::replace(layout.begin(), layout.end(), AudioChannelDescription(kAudioChannelLabel_SideLeft),
                 AudioChannelDescription(kAudioChannelLabel_LeftSurround));
    std::replace(layout.begin(), layout.end(), AudioChannelDescription(kAudioChannelLabel_SideRight),
                 AudioChannelDescription(kAudioChannelLabel_RightSurround));
}

std::string AdviceForUnreadable()
{
    switch (sf_error(nullptr))
    {
    case SF_ERR_SYSTEM:
        return "see that it is a file, and that you may read it";
    case SF_ERR_UNRECOGNISED_FORMAT:
    case SF_ERR_UNSUPPORTED_ENCODING:
        return "convert it to WAV or FLAC";
    default:
        return "it may be damaged; get a whole copy of it, or convert it to WAV or FLAC";
    }
}

} // namespace

AudioFileReader::AudioFileReader(const std::string& path) : mPath(path)
{
    const std::filesystem::path file = startfolder::Resolve(path);
    std::error_code error;
    if (!std::filesystem::exists(file, error))
    {
        throw Failure(ExitCode::FileTrouble, path + ": there is no such file; check its spelling");
    }
    if (std::filesystem::is_directory(file, error))
    {
        throw Failure(ExitCode::FileTrouble, path + " is a folder: name a sound file in it");
    }
    mFile.reset(sf_open(file.c_str(), SFM_READ, &mInfo));
    if (mFile == nullptr || mInfo.channels < 1 || mInfo.samplerate < 1)
    {
        throw Failure(ExitCode::FileTrouble, path + " cannot be read as a sound file (" + SoundFileError(nullptr) +
                                                 "): " + AdviceForUnreadable());
    }
    ReadLayout();
    ReadTexts();
}

// The last page of an Ogg file tells its length.
bool AudioFileReader::MayBeCutOff() const
{
    const bool hasNoLastPage = Format().container == SF_FORMAT_OGG && !KnowsFrames();
    return mInfo.seekable == SF_TRUE && (hasNoLastPage || HeadTellsMore(mFile.get()));
}

void AudioFileReader::ReadLayout()
{
    std::vector<int> codes(static_cast<std::size_t>(mInfo.channels));
    const auto bytes = static_cast<int>(codes.size() * sizeof(int));
    mLayout = UsualLayout(mInfo.channels);
    if (sf_command(mFile.get(), SFC_GET_CHANNEL_MAP_INFO, codes.data(), bytes) != SF_TRUE)
    {
        return;
    }
    mChannelCodes = codes;
    ChannelLayout told;
    std::transform(codes.begin(), codes.end(), std::back_inserter(told), [](int code) { return LabelOf(code); });
    NameSidesAsSurround(told);
    const bool complete = std::all_of(told.begin(), told.end(),
                                      [](const AudioChannelDescription& channel)
                                      { return channel.GetLabel() != kAudioChannelLabel_None; });
    mLayout = complete ? told : mLayout;
}

void AudioFileReader::ReadTexts()
{
    for (int kind = SF_STR_FIRST; kind <= SF_STR_LAST; ++kind)
    {
        const char* text = sf_get_string(mFile.get(), kind);
        if (text != nullptr && kind != SF_STR_SOFTWARE)
        {
            mTexts[kind] = text;
        }
    }
}

int AudioFileReader::Read(float* const* channels, int frames)
{
    const auto rows = static_cast<std::size_t>(mInfo.channels);
    mInterleaved.assign(rows * static_cast<std::size_t>(frames), 0.0F);
    const sf_count_t got = std::max<sf_count_t>(ReadInterleaved(frames), 0);
    mFramesRead += got;
    if (got < frames)
    {
        CheckEnd();
    }
    mMeter.Take(mInterleaved);
    for (std::size_t row = 0; row < rows; ++row)
    {
        for (std::size_t frame = 0; frame < static_cast<std::size_t>(frames); ++frame)
        {
            channels[row][frame] = mInterleaved[frame * rows + row];
        }
    }
    return static_cast<int>(got);
}

// libsndfile gives what it can read of a damaged file, and may call that no error.
void AudioFileReader::CheckEnd() const
{
    const std::string error = SoundFileError(mFile.get());
    const bool isShort = KnowsFrames() ? mFramesRead < Frames() : Frames() == SF_COUNT_MAX && mFramesRead == 0;
    if (error.empty() && !isShort)
    {
        return;
    }
    throw Failure(ExitCode::FileTrouble, mPath + " is damaged or cut off: only " + std::to_string(mFramesRead) +
                                             (KnowsFrames() ? " of its " + std::to_string(Frames()) : "") +
                                             " frames can be read" + (error.empty() ? "" : " (" + error + ")") +
                                             "; get a whole copy of it, or convert what there is to WAV");
}

// libsndfile's own way from integers to floats and back does not give the same integers again.
sf_count_t AudioFileReader::ReadInterleaved(int frames)
{
    if (Format().IntegerBits() == 0)
    {
        return sf_readf_float(mFile.get(), mInterleaved.data(), frames);
    }
    mIntegers.assign(mInterleaved.size(), 0);
    const sf_count_t got = sf_readf_int(mFile.get(), mIntegers.data(), frames);
    std::transform(mIntegers.begin(), mIntegers.end(), mInterleaved.begin(),
                   [](int value) { return static_cast<float>(value) * kIntegerScale; });
    return got;
}

} // namespace zebhost
