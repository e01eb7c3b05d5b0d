#pragma once

#include <cstdint>
#include <string>

namespace zebhost
{

// How a sound file holds its samples. The codes are libsndfile's.
struct SampleFormat
{
    int container = 0; // SF_FORMAT_WAV and the like
    int coding = 0;    // SF_FORMAT_PCM_24 and the like

    int Code() const { return container | coding; }
    // Bits of integer samples; 0 for all other codings.
    int IntegerBits() const;
    // Whether a 32-bit float holds every sample exactly.
    bool FitsFloat() const;
    // How long a file can be. Some containers end at 4 GiB, and libsndfile goes on without a word.
    std::int64_t MostFrames(int channels) const;
    // "24-bit", "32-bit float".
    std::string CodingName() const;
};

SampleFormat SampleFormatOf(int code);

// The format for an output file: the container by the file's extension, the coding as `wanted` ("16", "24", "32",
// "float", "double"), or like the input's as far as the container has it when `wanted` is empty. A WAV that may have
// more than `frames` allow becomes RF64. Throws a usage Failure for what cannot be written.
SampleFormat ChooseFormat(const SampleFormat& input, const std::string& inputPath, const std::string& outputPath,
                          const std::string& wanted, int channels, int sampleRate, std::int64_t frames);

// Whether a file of this container can have 32-bit floats.
bool HasFloats(const SampleFormat& format, int channels, int sampleRate);

} // namespace zebhost
