#include "render/Automation.h"

#include "cli/Failure.h"
#include "cli/StartFolder.h"
#include "filter/Parameters.h"
#include "filter/ValueFinder.h"
#include "output/Numbers.h"
#include "output/Strings.h"
#include "render/SeparatedLine.h"

#include <algorithm>
#include <cmath>
#include <fstream>
#include <optional>
#include <utility>

namespace zebhost
{

using zebaudiofilterhost::AudioFilter;

namespace
{

// The lines that count, with their numbers, from 1. Throws a Failure if the file cannot be read.
std::vector<std::pair<int, std::string>> ReadLines(const std::string& path)
{
    constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
    std::ifstream stream(startfolder::Resolve(path), std::ios::binary);
    std::vector<std::pair<int, std::string>> lines;
    std::string line;
    bool isHeading = true; // what the first of them may be
    for (int number = 1; std::getline(stream, line); ++number)
    {
        line.erase(0, number == 1 && line.starts_with(kByteOrderMark) ? kByteOrderMark.size() : 0);
        const std::string_view text = Trimmed(line);
        if (text.empty() || text.front() == '#')
        {
            continue;
        }
        if (!isHeading || !StartsWithIgnoringCase(text, "time"))
        {
            lines.emplace_back(number, line);
        }
        isHeading = false;
    }
    // A folder opens like a file, and fails when it is read.
    if (!stream.is_open() || stream.bad())
    {
        throw Failure(ExitCode::FileTrouble, path + " cannot be read: check its spelling, and that it is a file");
    }
    return lines;
}

std::int64_t FrameOf(const std::string& text, int sampleRate)
{
    constexpr double kLongest = 1e9; // seconds
    constexpr std::string_view kFrames = "frames";
    const std::string_view trimmed = Trimmed(text);
    const bool inFrames = trimmed.ends_with(kFrames);
    const std::optional<double> number =
        ParseNumber(inFrames ? trimmed.substr(0, trimmed.size() - kFrames.size()) : trimmed);
    if (!number || *number < 0 || *number > kLongest * (inFrames ? sampleRate : 1))
    {
        throw Failure(ExitCode::Usage, "'" + text + "' is no time: give seconds, or frames with 'frames' behind");
    }
    return std::llround(inFrames ? *number : *number * sampleRate);
}

float ValueOf(AudioFilter& filter, int parameter, const std::string& text)
{
    constexpr std::string_view kNormalised = "norm:";
    if (StartsWithIgnoringCase(text, kNormalised))
    {
        return ParseNormalised(text.substr(kNormalised.size()));
    }
    const auto info = filter.GetParameterInfo(parameter);
    if (info == nullptr)
    {
        throw Failure(ExitCode::Usage,
                      "the plug-in does not describe this parameter; write norm: and a value from 0 to 1");
    }
    return ValueFinder(filter, parameter, *info).Find(text).value;
}

AutomationEvent ParseLine(AudioFilter& filter, const std::string& line, int sampleRate)
{
    const std::vector<std::string> fields = SplitSeparatedLine(line);
    if (fields.size() != 3)
    {
        throw Failure(ExitCode::Usage, "write time, parameter and value, separated by commas or tabs");
    }
    const int parameter = FindParameter(filter, fields[1]);
    return {FrameOf(fields[0], sampleRate), parameter, ValueOf(filter, parameter, fields[2])};
}

} // namespace

std::vector<AutomationEvent> ReadAutomation(const std::string& path, AudioFilter& filter, int sampleRate)
{
    std::vector<AutomationEvent> events;
    for (const auto& [number, line] : ReadLines(path))
    {
        try
        {
            events.push_back(ParseLine(filter, line, sampleRate));
        }
        catch (const Failure& failure)
        {
            throw Failure(failure.Code(), path + ", line " + std::to_string(number) + ": " + failure.what());
        }
    }
    std::stable_sort(events.begin(), events.end(),
                     [](const AutomationEvent& a, const AutomationEvent& b) { return a.frame < b.frame; });
    return events;
}

} // namespace zebhost
