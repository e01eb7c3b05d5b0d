#pragma once

#include "audio/AudioFileReader.h"
#include "audio/AudioFileWriter.h"
#include "commands/CommandContext.h"
#include "commands/FilterCommand.h"
#include "render/RenderJob.h"
#include "render/RenderOptions.h"
#include "render/Routing.h"

#include <chrono>
#include <memory>
#include <string>

namespace zebhost
{

// Renders one file through an instance of the filter of its own, so that no file hears another's echo.
class FileRenderer
{
public:
    // `number` begins each remark: "2/5 ", or nothing.
    FileRenderer(const CommandContext& context, const RenderOptions& options, std::string number);

    // Returns what JSON output tells of the file. Throws a Failure; the output is then not there.
    Json Render(const std::string& input, const std::string& output);
    Json FilterDocument() const;

private:
    std::unique_ptr<AudioFileReader> OpenSideChain(const AudioFileReader& input) const;
    Routing Configure(const AudioFileReader& input, const AudioFileReader* sideChain);
    RenderJob::Progress MakeProgress(const AudioFileReader& input);
    void RemarkOnRouting(const AudioFileReader& input, const Routing& routing) const;
    void RemarkOnSamples(const AudioFileReader& input, const SampleFormat& format,
                         const AudioFileWriter& output) const;
    void RemarkOnClipping(const AudioFileReader& input, const SampleFormat& format,
                          const AudioFileWriter& output) const;
    void WarnOfInput(const AudioFileReader& input) const;
    void WarnOfBrokenSamples(const SampleMeter& meter, const std::string& whose) const;
    void RemarkOnResult(const AudioFileReader& input, const std::string& output, int latency,
                        const RenderResult& result, const AudioFileWriter& writer) const;
    void Remark(const std::string& text) const;

    const CommandContext& mContext;
    const RenderOptions& mOptions;
    std::string mNumber;
    HostTime mTime;
    FilterOfCommand mFilter;
    std::chrono::steady_clock::time_point mLastProgress{};
};

} // namespace zebhost
