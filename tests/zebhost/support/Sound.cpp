#include "tests/zebhost/support/Sound.h"

#include <gtest/gtest.h>

#include <random>

namespace zebtest
{

Sound MakeNoise(int channels, std::size_t frames, int format)
{
    Sound sound;
    sound.format = format;
    std::mt19937 random(12345);
    std::uniform_int_distribution<int> level(-0x7FFFFF, 0x7FFFFF);
    for (int channel = 0; channel < channels; ++channel)
    {
        std::vector<int>& row = sound.channels.emplace_back();
        for (std::size_t frame = 0; frame < frames; ++frame)
        {
            row.push_back(level(random) / 2 * 256);
        }
    }
    return sound;
}

void WriteFloats(const std::string& path, const std::vector<float>& samples)
{
    SF_INFO info{};
    info.samplerate = 48000;
    info.channels = 1;
    info.format = SF_FORMAT_WAV | SF_FORMAT_FLOAT;
    SNDFILE* file = sf_open(path.c_str(), SFM_WRITE, &info);
    ASSERT_NE(file, nullptr) << path;
    sf_writef_float(file, samples.data(), static_cast<sf_count_t>(samples.size()));
    sf_close(file);
}

void WriteSound(const std::string& path, const Sound& sound)
{
    SF_INFO info{};
    info.samplerate = sound.rate;
    info.channels = static_cast<int>(sound.channels.size());
    info.format = sound.format;
    SNDFILE* file = sf_open(path.c_str(), SFM_WRITE, &info);
    ASSERT_NE(file, nullptr) << path << ": " << sf_strerror(nullptr);
    for (std::size_t frame = 0; frame < sound.Frames(); ++frame)
    {
        std::vector<int> samples;
        for (const std::vector<int>& row : sound.channels)
        {
            samples.push_back(row[frame]);
        }
        sf_writef_int(file, samples.data(), 1);
    }
    sf_close(file);
}

Sound ReadSound(const std::string& path)
{
    SF_INFO info{};
    SNDFILE* file = sf_open(path.c_str(), SFM_READ, &info);
    if (file == nullptr)
    {
        return {};
    }
    Sound sound;
    sound.rate = info.samplerate;
    sound.format = info.format;
    const auto rows = static_cast<std::size_t>(info.channels);
    const auto frames = static_cast<std::size_t>(info.frames);
    std::vector<int> integers(rows * frames);
    std::vector<float> floats(rows * frames);
    sf_readf_int(file, integers.data(), info.frames);
    sf_seek(file, 0, SEEK_SET);
    sf_readf_float(file, floats.data(), info.frames);
    sf_close(file);
    sound.channels.assign(rows, std::vector<int>(frames));
    sound.floats.assign(rows, std::vector<float>(frames));
    for (std::size_t index = 0; index < integers.size(); ++index)
    {
        sound.channels[index % rows][index / rows] = integers[index];
        sound.floats[index % rows][index / rows] = floats[index];
    }
    return sound;
}

} // namespace zebtest
