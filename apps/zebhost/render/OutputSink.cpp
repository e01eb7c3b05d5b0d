#include "render/OutputSink.h"

#include <algorithm>
#include <cmath>

namespace zebhost
{

OutputSink::OutputSink(AudioFileWriter& writer, int channels, std::int64_t framesToDrop)
    : mWriter(writer), mChannels(channels), mFramesToDrop(framesToDrop)
{
}

void OutputSink::Take(const float* const* channels, int frames)
{
    const int dropped = static_cast<int>(std::min<std::int64_t>(mFramesToDrop, frames));
    mFramesToDrop -= dropped;
    const int left = frames - dropped;
    if (left == 0)
    {
        return;
    }
    if (mLevel > 0 && IsQuiet(channels, dropped, left))
    {
        Hold(channels, dropped, left);
        return;
    }
    ReleaseHeld();
    mWriter.Write(channels, dropped, left);
}

void OutputSink::HoldBelow(float level)
{
    mLevel = level;
}

bool OutputSink::IsQuiet(const float* const* channels, int first, int frames) const
{
    for (int channel = 0; channel < mChannels; ++channel)
    {
        const float* begin = channels[channel] + first;
        if (std::any_of(begin, begin + frames, [this](float sample) { return !(std::abs(sample) < mLevel); }))
        {
            return false;
        }
    }
    return true;
}

void OutputSink::Hold(const float* const* channels, int first, int frames)
{
    HeldBlock block;
    block.frames = frames;
    for (int channel = 0; channel < mChannels; ++channel)
    {
        block.rows.emplace_back(channels[channel] + first, channels[channel] + first + frames);
    }
    mHeld.push_back(std::move(block));
    mHeldFrames += frames;
}

void OutputSink::ReleaseHeld()
{
    for (const HeldBlock& block : mHeld)
    {
        std::vector<const float*> rows;
        for (const std::vector<float>& row : block.rows)
        {
            rows.push_back(row.data());
        }
        mWriter.Write(rows.data(), 0, block.frames);
    }
    mHeld.clear();
    mHeldFrames = 0;
}

} // namespace zebhost
