#pragma once

#include <sndfile.h>

#include <string>
#include <vector>

namespace zebtest
{

// A sound file in memory: rows of samples as 32-bit integers, which every integer format fits exactly, or as floats.
struct Sound
{
    int rate = 48000;
    int format = SF_FORMAT_WAV | SF_FORMAT_PCM_24;
    std::vector<std::vector<int>> channels;
    std::vector<std::vector<float>> floats; // filled by ReadSound only

    std::size_t Frames() const { return channels.empty() ? 0 : channels.front().size(); }
};

// Noise of all levels that are multiples of 1/2^23, the same for the same numbers.
Sound MakeNoise(int channels, std::size_t frames, int format = SF_FORMAT_WAV | SF_FORMAT_PCM_24);

// A WAV of one channel of 32-bit floats.
void WriteFloats(const std::string& path, const std::vector<float>& samples);
void WriteSound(const std::string& path, const Sound& sound);
// An empty sound if there is no such file.
Sound ReadSound(const std::string& path);

} // namespace zebtest
