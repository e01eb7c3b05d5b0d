#pragma once

#include "audio/AudioFileWriter.h"

#include <cstdint>
#include <vector>

namespace zebhost
{

// Stands between the filter and the file: leaves out the latency at the front, and holds quiet blocks of the tail
// back until something louder follows.
class OutputSink
{
public:
    OutputSink(AudioFileWriter& writer, int channels, std::int64_t framesToDrop);

    void Take(const float* const* channels, int frames);

    // From now on blocks whose samples stay below `level` are held back.
    void HoldBelow(float level);
    // How long it has been quiet.
    std::int64_t HeldFrames() const { return mHeldFrames; }

private:
    struct HeldBlock
    {
        std::vector<std::vector<float>> rows;
        int frames = 0;
    };

    bool IsQuiet(const float* const* channels, int first, int frames) const;
    void Hold(const float* const* channels, int first, int frames);
    void ReleaseHeld();

    AudioFileWriter& mWriter;
    int mChannels;
    std::int64_t mFramesToDrop;
    float mLevel = 0;
    std::vector<HeldBlock> mHeld;
    std::int64_t mHeldFrames = 0;
};

} // namespace zebhost
