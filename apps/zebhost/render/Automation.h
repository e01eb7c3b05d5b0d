#pragma once

#include <audiofilter/AudioFilter.h>

#include <cstdint>
#include <string>
#include <vector>

namespace zebhost
{

// One change of a parameter.
struct AutomationEvent
{
    std::int64_t frame = 0; // of the input
    int parameter = 0;
    float value = 0; // normalised
};

// Reads an automation file: lines of time, parameter and value, separated by commas or tabs, in any order of time.
// The time is in seconds, or in frames with "frames" behind it. The value is what the plug-in displays, or a
// normalised value behind "norm:". Text in double quotes may hold the separator. Empty lines, lines that begin with
// '#', and a heading that begins with "time" are passed over. The result is sorted by time. No audio may run: the
// plug-in may be asked by setting its parameters for a moment. Throws a Failure that names the line.
std::vector<AutomationEvent> ReadAutomation(const std::string& path, zebaudiofilterhost::AudioFilter& filter,
                                            int sampleRate);

} // namespace zebhost
