#include "commands/FileRenderer.h"

#include "audio/ChannelNames.h"
#include "cli/Failure.h"
#include "commands/FilterJson.h"
#include "filter/Interrupt.h"
#include "filter/ParameterSetup.h"
#include "output/Numbers.h"
#include "output/ProgressBar.h"
#include "output/Strings.h"
#include "render/RunningFilter.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

namespace zebhost
{

namespace
{

double Speed(const RenderResult& result, int sampleRate)
{
    return static_cast<double>(result.framesIn) / sampleRate / std::max(result.seconds, 1e-6);
}

std::string SpeedText(double speed)
{
    return FixedNumber(speed, speed < 10 ? 1 : 0) + " times real time";
}

// With the tail and the latency.
std::int64_t MostFramesOut(const AudioFileReader& input, const RenderOptions& options)
{
    const double seconds = options.tail.LongestSeconds() + (options.trim ? 0 : RunningFilter::kLongestSeconds);
    const std::int64_t more = std::llround(seconds * input.SampleRate());
    return std::min(input.Frames(), std::numeric_limits<std::int64_t>::max() - more) + more;
}

// A plug-in that fails in each block, or is not set up, sounds like this.
bool IsSilenced(const AudioFileReader& input, const AudioFileWriter& output)
{
    return input.Meter().Peak() > 0 && output.Meter().Peak() == 0;
}

std::vector<std::string> NamesOf(const std::vector<int>& channels, const zebmediatypes::ChannelLayout& layout)
{
    const std::vector<std::string> all = ChannelNames(layout);
    std::vector<std::string> names;
    for (const int channel : channels)
    {
        names.push_back(all[static_cast<std::size_t>(channel)]);
    }
    return names;
}

Json ResultJson(const AudioFileReader& input, const std::string& output, const Routing& routing, int latency,
                const RenderOptions& options, const RenderResult& result, const AudioFileWriter& writer,
                const SampleFormat& format)
{
    return Json{{"input", input.Path()},
                {"output", output},
                {"sampleRate", input.SampleRate()},
                {"channels", input.Channels()},
                {"coding", format.CodingName()},
                {"processedChannels", NamesOf(routing.processed, input.Layout())},
                {"framesIn", result.framesIn},
                {"framesOut", writer.Frames()},
                {"latency", latency},
                {"latencyTrimmed", options.trim},
                {"tailFrames", result.tailFrames},
                {"tailCut", result.tailWasCut},
                {"peak", writer.Meter().Peak()},
                {"silenced", IsSilenced(input, writer)},
                {"clippedSamples", writer.ClippedSamples()},
                {"brokenSamples", writer.Meter().BrokenSamples()},
                {"brokenSamplesIn", input.Meter().BrokenSamples()},
                {"seconds", result.seconds},
                {"speed", Speed(result, input.SampleRate())}};
}

} // namespace

FileRenderer::FileRenderer(const CommandContext& context, const RenderOptions& options, std::string number)
    : mContext(context)
    , mOptions(options)
    , mNumber(std::move(number))
    , mTime(options.time)
    , mFilter(context, options.settleMs)
{
}

Json FileRenderer::FilterDocument() const
{
    return DescriptorJson(mFilter.Descriptor());
}

Json FileRenderer::Render(const std::string& input, const std::string& output)
{
    AudioFileReader reader(input);
    OutputFile file(output, mOptions.overwrite);
    const std::unique_ptr<AudioFileReader> sideChain = OpenSideChain(reader);
    const SampleFormat format = ChooseFormat(reader.Format(), input, output, mOptions.format, reader.Channels(),
                                             reader.SampleRate(), MostFramesOut(reader, mOptions));
    const Routing routing = Configure(reader, sideChain.get());
    ApplyParameterOptions(mContext, *mFilter, mOptions.settleMs);
    const std::vector<AutomationEvent> events =
        mOptions.automation.empty() ? std::vector<AutomationEvent>()
                                    : ReadAutomation(mOptions.automation, *mFilter, reader.SampleRate());
    AudioFileWriter writer(file, format, reader);
    RemarkOnRouting(reader, routing);
    const RenderJob::Progress progress = MakeProgress(reader);
    const RunningFilter running(*mFilter, reader.SampleRate(), mOptions.settleMs);
    const int latency = running.Latency();
    const RenderResult result =
        RenderJob(*mFilter, routing, mOptions, {reader, sideChain.get(), writer}, events, latency, progress).Run();
    writer.Finish();
    WarnOfInput(reader);
    if (sideChain != nullptr)
    {
        WarnOfInput(*sideChain);
    }
    WarnOfBrokenSamples(writer.Meter(), mFilter.Name() + " gave");
    RemarkOnSamples(reader, format, writer);
    RemarkOnClipping(reader, format, writer);
    RemarkOnResult(reader, output, latency, result, writer);
    return ResultJson(reader, output, routing, latency, mOptions, result, writer, format);
}

std::unique_ptr<AudioFileReader> FileRenderer::OpenSideChain(const AudioFileReader& input) const
{
    if (mOptions.sideChain.empty())
    {
        return nullptr;
    }
    auto reader = std::make_unique<AudioFileReader>(mOptions.sideChain);
    if (reader->SampleRate() != input.SampleRate())
    {
        throw Failure(ExitCode::JobFailed, mOptions.sideChain + " has " + std::to_string(reader->SampleRate()) +
                                               " Hz and " + input.Path() + " " + std::to_string(input.SampleRate()) +
                                               " Hz: convert one of them first");
    }
    return reader;
}

Routing FileRenderer::Configure(const AudioFileReader& input, const AudioFileReader* sideChain)
{
    RoutingRequest request;
    request.file = input.Layout();
    request.on = mOptions.on.empty() ? std::vector<int>() : ParseChannels(mOptions.on, input.Layout());
    request.sideChain = sideChain == nullptr ? zebmediatypes::ChannelLayout() : sideChain->Layout();
    mFilter->SetRenderingContext(mOptions.realtime ? zebaudiofilterhost::kRenderingContext_Realtime
                                                   : zebaudiofilterhost::kRenderingContext_Offline);
    const Routing routing = RouteFilter(*mFilter, request);
    mFilter->SetSampleRate(static_cast<float>(input.SampleRate()));
    mFilter->SetBlockSize(mOptions.block);
    mFilter->SetAudioFilterHost(&mTime);
    return routing;
}

RenderJob::Progress FileRenderer::MakeProgress(const AudioFileReader& input)
{
    const std::int64_t total = input.Frames();
    const int rate = input.SampleRate();
    const std::string name = mNumber + input.Path();
    const auto start = std::chrono::steady_clock::now();
    return [this, total, rate, name, start](std::int64_t frames)
    {
        if (interrupt::IsRequested())
        {
            throw Failure(ExitCode::JobFailed, name + ": interrupted; no output was written");
        }
        const auto now = std::chrono::steady_clock::now();
        if (now - mLastProgress < std::chrono::milliseconds(100))
        {
            return;
        }
        mLastProgress = now;
        const double seconds = std::max(std::chrono::duration<double>(now - start).count(), 1e-3);
        const double done = static_cast<double>(frames) / rate;
        mContext.console.ShowProgress(
            ProgressBar(std::min(frames, total) / rate, total / rate, "s " + name + " " + SpeedText(done / seconds)));
    };
}

void FileRenderer::RemarkOnRouting(const AudioFileReader& input, const Routing& routing) const
{
    const std::size_t processed = routing.processed.size();
    if (processed < static_cast<std::size_t>(input.Channels()))
    {
        Remark(mFilter.Name() + " works on " + Joined(NamesOf(routing.processed, input.Layout()), ", ") + " of " +
               Joined(ChannelNames(input.Layout()), ", ") + "; the others pass by, delayed by its latency");
    }
    if (routing.paddingSource >= 0)
    {
        Remark(mFilter.Name() +
               " takes no single channel: it gets the same on all its inputs, and its first output is "
               "kept");
    }
    if (!input.Format().FitsFloat())
    {
        Remark(
            input.Path() + " has " + input.Format().CodingName() +
            " samples; they are processed as 32-bit floats, so the last bits of channels that pass by are rounded");
    }
}

void FileRenderer::RemarkOnSamples(const AudioFileReader& input, const SampleFormat& format,
                                   const AudioFileWriter& output) const
{
    if (format.coding != input.Format().coding && mOptions.format.empty())
    {
        Remark("the output has " + format.CodingName() + " samples, for its kind of file has no " +
               input.Format().CodingName());
    }
    if (IsSilenced(input, output))
    {
        Remark(
            "the whole output is silent, though " + input.Path() + " is not: " + mFilter.Name() +
            " may fail in each block, or be set so; look at 'zebhost params', try --settle 1000 or another --block");
    }
}

void FileRenderer::RemarkOnClipping(const AudioFileReader& input, const SampleFormat& format,
                                    const AudioFileWriter& output) const
{
    if (output.ClippedSamples() > 0)
    {
        const bool hasFloats = HasFloats(format, input.Channels(), input.SampleRate());
        mContext.console.Warn(
            "zebhost: " + mNumber + Counted(static_cast<std::size_t>(output.ClippedSamples()), "sample") +
            " clipped, the highest at " + FixedNumber(static_cast<double>(output.Meter().Peak()), 3) +
            ": turn it down, or " + (hasFloats ? "give --format float" : "write a .wav with --format float"));
    }
}

void FileRenderer::WarnOfInput(const AudioFileReader& input) const
{
    if (input.MayBeCutOff())
    {
        mContext.console.Warn("zebhost: " + mNumber + input.Path() +
                              " seems to be cut off, and is taken as far as it goes; see that it is whole");
    }
    WarnOfBrokenSamples(input.Meter(), input.Path() + " has");
}

void FileRenderer::WarnOfBrokenSamples(const SampleMeter& meter, const std::string& whose) const
{
    if (meter.BrokenSamples() > 0)
    {
        mContext.console.Warn("zebhost: " + mNumber + whose + " " +
                              Counted(static_cast<std::size_t>(meter.BrokenSamples()), "sample") +
                              " that are no numbers; silence stands in their place");
    }
}

void FileRenderer::RemarkOnResult(const AudioFileReader& input, const std::string& output, int latency,
                                  const RenderResult& result, const AudioFileWriter& writer) const
{
    const double rate = input.SampleRate();
    if (result.tailWasCut)
    {
        Remark("the tail was cut off after a minute; --tail SECONDS takes more");
    }
    std::string text = output + ": " + FixedNumber(static_cast<double>(writer.Frames()) / rate, 2) + " s written, " +
                       SpeedText(Speed(result, input.SampleRate()));
    if (latency > 0)
    {
        text += ", latency of " + Counted(static_cast<std::size_t>(latency), "frame") +
                (mOptions.trim ? " cut off the front" : " kept");
    }
    if (result.tailFrames > 0)
    {
        text += ", tail of " + FixedNumber(static_cast<double>(result.tailFrames) / rate, 2) + " s";
    }
    Remark(text);
}

void FileRenderer::Remark(const std::string& text) const
{
    mContext.console.Remark("zebhost: " + mNumber + text);
}

} // namespace zebhost
