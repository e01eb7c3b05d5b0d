#include "audio/SampleFormat.h"

#include "audio/WritingTrial.h"
#include "cli/Failure.h"
#include "output/Strings.h"

#include <sndfile.h>

#include <algorithm>
#include <array>
#include <filesystem>
#include <utility>
#include <vector>

namespace zebhost
{

namespace
{

constexpr std::array<std::pair<const char*, int>, 17> kContainers = {{{".wav", SF_FORMAT_WAV},
                                                                      {".wave", SF_FORMAT_WAV},
                                                                      {".w64", SF_FORMAT_W64},
                                                                      {".rf64", SF_FORMAT_RF64},
                                                                      {".flac", SF_FORMAT_FLAC},
                                                                      {".aif", SF_FORMAT_AIFF},
                                                                      {".aiff", SF_FORMAT_AIFF},
                                                                      {".aifc", SF_FORMAT_AIFF},
                                                                      {".au", SF_FORMAT_AU},
                                                                      {".snd", SF_FORMAT_AU},
                                                                      {".caf", SF_FORMAT_CAF},
                                                                      {".ogg", SF_FORMAT_OGG},
                                                                      {".oga", SF_FORMAT_OGG},
                                                                      {".opus", SF_FORMAT_OGG},
                                                                      {".mp3", SF_FORMAT_MPEG},
                                                                      {".raw", SF_FORMAT_RAW},
                                                                      {".voc", SF_FORMAT_VOC}}};

constexpr std::array<std::pair<const char*, int>, 5> kWanted = {{{"16", SF_FORMAT_PCM_16},
                                                                 {"24", SF_FORMAT_PCM_24},
                                                                 {"32", SF_FORMAT_PCM_32},
                                                                 {"float", SF_FORMAT_FLOAT},
                                                                 {"double", SF_FORMAT_DOUBLE}}};

std::string ExtensionOf(const std::string& path)
{
    return Lowered(std::filesystem::path(path).extension().string());
}

bool IsWav(int container)
{
    return container == SF_FORMAT_WAV || container == SF_FORMAT_WAVEX || container == SF_FORMAT_RF64;
}

int ContainerFor(const SampleFormat& input, const std::string& inputPath, const std::string& outputPath)
{
    const std::string extension = ExtensionOf(outputPath);
    if (extension == ExtensionOf(inputPath) && !extension.empty())
    {
        return input.container;
    }
    const auto found = std::find_if(kContainers.begin(), kContainers.end(),
                                    [&extension](const auto& each) { return extension == each.first; });
    if (found == kContainers.end())
    {
        throw Failure(ExitCode::Usage, outputPath + ": what kind of file is that to be? Let its name end in .wav, "
                                                    ".flac, .aiff, .caf, .w64, .ogg, .opus or .mp3");
    }
    return found->second;
}

bool CanWrite(const SampleFormat& format, int channels, int sampleRate)
{
    SF_INFO info{};
    info.channels = channels;
    info.samplerate = sampleRate;
    info.format = format.Code();
    return IsWritable(info);
}

// From the closest to the least.
std::vector<int> CodingsLike(const SampleFormat& input, const std::string& outputPath)
{
    if (ExtensionOf(outputPath) == ".opus")
    {
        return {SF_FORMAT_OPUS};
    }
    std::vector<int> codings = {input.coding};
    if (input.IntegerBits() == 8)
    {
        codings.insert(codings.end(), {SF_FORMAT_PCM_U8, SF_FORMAT_PCM_S8, SF_FORMAT_PCM_16});
    }
    else if (input.IntegerBits() == 16)
    {
        codings.push_back(SF_FORMAT_PCM_16);
    }
    else if (input.IntegerBits() == 32)
    {
        codings.push_back(SF_FORMAT_PCM_32);
    }
    const std::vector<int> rest = input.IntegerBits() > 0
                                      ? std::vector<int>{SF_FORMAT_PCM_24, SF_FORMAT_FLOAT, SF_FORMAT_PCM_16}
                                      : std::vector<int>{SF_FORMAT_FLOAT, SF_FORMAT_PCM_24, SF_FORMAT_PCM_16};
    codings.insert(codings.end(), rest.begin(), rest.end());
    codings.insert(codings.end(), {SF_FORMAT_VORBIS, SF_FORMAT_OPUS, SF_FORMAT_MPEG_LAYER_III});
    return codings;
}

std::vector<int> CodingsFor(const SampleFormat& input, const std::string& outputPath, const std::string& wanted)
{
    const auto found =
        std::find_if(kWanted.begin(), kWanted.end(), [&wanted](const auto& each) { return wanted == each.first; });
    return found == kWanted.end() ? CodingsLike(input, outputPath) : std::vector<int>{found->second};
}

// A plain WAV has no place for speaker positions, and ends at 4 GiB.
int FittingWav(const SampleFormat& format, int channels, std::int64_t frames)
{
    if (!IsWav(format.container))
    {
        return format.container;
    }
    if (frames > format.MostFrames(channels))
    {
        return SF_FORMAT_RF64;
    }
    return channels > 2 && format.container == SF_FORMAT_WAV ? SF_FORMAT_WAVEX : format.container;
}

} // namespace

SampleFormat SampleFormatOf(int code)
{
    return {code & SF_FORMAT_TYPEMASK, code & SF_FORMAT_SUBMASK};
}

int SampleFormat::IntegerBits() const
{
    switch (coding)
    {
    case SF_FORMAT_PCM_S8:
    case SF_FORMAT_PCM_U8:
        return 8;
    case SF_FORMAT_PCM_16:
        return 16;
    case SF_FORMAT_PCM_24:
        return 24;
    case SF_FORMAT_PCM_32:
        return 32;
    default:
        return 0;
    }
}

bool SampleFormat::FitsFloat() const
{
    return IntegerBits() != 32 && coding != SF_FORMAT_DOUBLE;
}

std::int64_t SampleFormat::MostFrames(int channels) const
{
    constexpr std::int64_t kMostBytes = 0xFFF00000; // leaves room for all that stands around the samples
    const bool hasShortSizes = container == SF_FORMAT_WAV || container == SF_FORMAT_WAVEX ||
                               container == SF_FORMAT_AIFF || container == SF_FORMAT_SVX;
    const int most = coding == SF_FORMAT_DOUBLE ? 8 : 4;
    const std::int64_t bytes = IntegerBits() > 0 ? IntegerBits() / 8 : most;
    return hasShortSizes ? kMostBytes / (bytes * std::max(channels, 1)) : SF_COUNT_MAX;
}

std::string SampleFormat::CodingName() const
{
    if (IntegerBits() > 0)
    {
        return std::to_string(IntegerBits()) + "-bit";
    }
    SF_FORMAT_INFO info{};
    info.format = coding;
    if (coding == SF_FORMAT_FLOAT || coding == SF_FORMAT_DOUBLE)
    {
        return coding == SF_FORMAT_FLOAT ? "32-bit float" : "64-bit float";
    }
    const bool known = sf_command(nullptr, SFC_GET_FORMAT_INFO, &info, sizeof(info)) == 0 && info.name != nullptr;
    return known ? info.name : "unknown coding";
}

SampleFormat ChooseFormat(const SampleFormat& input, const std::string& inputPath, const std::string& outputPath,
                          const std::string& wanted, int channels, int sampleRate, std::int64_t frames)
{
    SampleFormat format;
    const int container = ContainerFor(input, inputPath, outputPath);
    for (const int coding : CodingsFor(input, outputPath, wanted))
    {
        format = {container, coding};
        format.container = FittingWav(format, channels, frames);
        if (CanWrite(format, channels, sampleRate))
        {
            return format;
        }
    }
    throw Failure(ExitCode::Usage, outputPath + ": " + Counted(static_cast<std::size_t>(channels), "channel") +
                                       " at " + std::to_string(sampleRate) + " Hz" +
                                       (wanted.empty() ? "" : " with --format " + wanted) +
                                       " cannot be written to a file of this kind; .wav takes nearly everything");
}

bool HasFloats(const SampleFormat& format, int channels, int sampleRate)
{
    return CanWrite({format.container, SF_FORMAT_FLOAT}, channels, sampleRate);
}

} // namespace zebhost
