#include "render/RenderJob.h"

#include "filter/DenormalGuard.h"

#include <foundation/zebcore/MainThreadLoop.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <limits>

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;
using zebaudiofilterhost::ChannelFlags;

namespace
{

constexpr unsigned int kEndlessTail = 0xFFFFFFFF;
constexpr double kQuietTime = 0.5;    // seconds below the level that end the tail
constexpr double kEndlessLevel = -90; // decibels, for a plug-in that calls its tail endless

std::int64_t FramesOf(double seconds, int sampleRate)
{
    return std::llround(seconds * sampleRate);
}

} // namespace

RenderJob::RenderJob(AudioFilter& filter, const Routing& routing, const RenderOptions& options, const Files& files,
                     const std::vector<AutomationEvent>& events, int latency, const Progress& progress)
    : mFilter(filter)
    , mOptions(options)
    , mFiles(files)
    , mEvents(events)
    , mProgress(progress)
    , mLatency(latency)
    , mRow(routing, options.block)
    , mSink(files.output, routing.fileChannels, options.trim ? latency : 0)
{
}

RenderResult RenderJob::Run()
{
    const DenormalGuard guard;
    const auto start = std::chrono::steady_clock::now();
    RenderInput();
    mResult.framesIn = mPosition;
    mRow.SilenceInputs();
    RenderSilence(mLatency);
    const std::int64_t before = mFiles.output.Frames();
    RenderTail();
    mResult.tailFrames = mFiles.output.Frames() - before;
    mResult.seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    return mResult;
}

int RenderJob::NextBlock(std::int64_t limit) const
{
    std::int64_t frames = std::min<std::int64_t>(limit, mOptions.block);
    if (mNextEvent < mEvents.size())
    {
        frames = std::min(frames, std::max<std::int64_t>(mEvents[mNextEvent].frame - mPosition, 1));
    }
    return static_cast<int>(frames);
}

void RenderJob::RenderInput()
{
    for (bool more = true; more;)
    {
        ApplyEvents();
        const int wanted = NextBlock(std::numeric_limits<std::int64_t>::max());
        const int got = mFiles.input.Read(mRow.FileInputs(), wanted);
        if (mFiles.sideChain != nullptr)
        {
            mFiles.sideChain->Read(mRow.SideInputs(), wanted);
        }
        more = got == wanted;
        if (got > 0)
        {
            RenderBlock(got);
        }
    }
}

void RenderJob::RenderSilence(std::int64_t frames)
{
    while (frames > 0)
    {
        ApplyEvents();
        const int block = NextBlock(frames);
        RenderBlock(block);
        frames -= block;
    }
}

void RenderJob::RenderTail()
{
    const int rate = mFiles.input.SampleRate();
    const unsigned int told = mFilter.GetTail();
    switch (mOptions.tail.kind)
    {
    case TailLength::Kind::Seconds:
        RenderSilence(FramesOf(mOptions.tail.seconds, rate));
        return;
    case TailLength::Kind::Level:
        RenderLevelTail(mOptions.tail.decibels);
        return;
    case TailLength::Kind::Auto:
        break;
    }
    if (told == kEndlessTail)
    {
        RenderLevelTail(kEndlessLevel);
        return;
    }
    const std::int64_t longest = FramesOf(mOptions.tail.LongestSeconds(), rate);
    mResult.tailWasCut = told > longest;
    RenderSilence(std::min<std::int64_t>(told, longest));
}

void RenderJob::RenderLevelTail(double decibels)
{
    const int rate = mFiles.input.SampleRate();
    const std::int64_t end = mPosition + FramesOf(mOptions.tail.LongestSeconds(), rate);
    const std::int64_t quiet = FramesOf(kQuietTime, rate);
    mSink.HoldBelow(static_cast<float>(std::pow(10.0, decibels / 20)));
    while (mSink.HeldFrames() < quiet && mPosition < end)
    {
        RenderSilence(std::min<std::int64_t>(mOptions.block, end - mPosition));
    }
    mResult.tailWasCut = mSink.HeldFrames() == 0;
}

void RenderJob::RenderBlock(int frames)
{
    mRow.SilenceOutputs();
    mFilter.SetCurrentOffset(mPosition);
    // Channels that the filter calls silent were left at the zeros above or written as such, so the flags tell
    // nothing more.
    ChannelFlags silent;
    mFilter.ProcessWithMapping(mRow.Inputs(), mRow.Outputs(), frames, ChannelFlags(), silent);
    mSink.Take(mRow.Outputs(), frames);
    mPosition += frames;
    zebcore::threads::PumpMainThread();
    mProgress(mPosition);
}

// This thread owns the plug-in between two blocks, so a change need not go through the message queue.
void RenderJob::ApplyEvents()
{
    for (; mNextEvent < mEvents.size() && mEvents[mNextEvent].frame <= mPosition; ++mNextEvent)
    {
        mFilter.SetParameter(mEvents[mNextEvent].parameter, mEvents[mNextEvent].value);
    }
}

} // namespace zebhost
