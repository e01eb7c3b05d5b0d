#pragma once

#include "audio/AudioFileReader.h"
#include "audio/AudioFileWriter.h"
#include "render/Automation.h"
#include "render/ChannelRow.h"
#include "render/OutputSink.h"
#include "render/RenderOptions.h"
#include "render/Routing.h"

#include <audiofilter/AudioFilter.h>
#include <boost/function.hpp>

#include <cstdint>
#include <vector>

namespace zebhost
{

struct RenderResult
{
    std::int64_t framesIn = 0;
    std::int64_t tailFrames = 0;
    bool tailWasCut = false; // still above the level when its longest time was over
    double seconds = 0;      // of work
};

// Runs one file through a filter that runs already, on this thread, which is both main and process thread: between
// two blocks it serves the plug-in's timers. [main]
class RenderJob
{
public:
    struct Files
    {
        AudioFileReader& input;
        AudioFileReader* sideChain; // may be null
        AudioFileWriter& output;
    };

    // Told of the frames read so far, between blocks. Throws to end the job.
    using Progress = boost::function<void(std::int64_t framesRead)>;

    RenderJob(zebaudiofilterhost::AudioFilter& filter, const Routing& routing, const RenderOptions& options,
              const Files& files, const std::vector<AutomationEvent>& events, int latency, const Progress& progress);

    RenderResult Run();

private:
    void RenderInput();
    void RenderSilence(std::int64_t frames);
    void RenderTail();
    void RenderLevelTail(double decibels);
    void RenderBlock(int frames);
    void ApplyEvents();
    // Frames until the next change of a parameter, at most a block and at least 1.
    int NextBlock(std::int64_t limit) const;

    zebaudiofilterhost::AudioFilter& mFilter;
    const RenderOptions& mOptions;
    Files mFiles;
    const std::vector<AutomationEvent>& mEvents;
    const Progress& mProgress;
    int mLatency;
    ChannelRow mRow;
    OutputSink mSink;
    std::size_t mNextEvent = 0;
    std::int64_t mPosition = 0; // of the next block, in frames of the input
    RenderResult mResult;
};

} // namespace zebhost
