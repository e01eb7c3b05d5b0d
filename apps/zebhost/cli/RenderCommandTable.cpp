#include "cli/CommandTableParts.h"

namespace zebhost
{

namespace
{

std::vector<OptionSpec> OutputOptions()
{
    return {
        {"out-dir", "DIR", "write one output for each FILE into DIR, under the same name", Values::Folder},
        {"overwrite", "", "replace output files that exist"},
        {"format",
         "FORMAT",
         "sample format of the output; like the input's if not given",
         Values::Choice,
         false,
         {"16", "24", "32", "float", "double"}},
    };
}

std::vector<OptionSpec> RoutingOptions()
{
    return {
        {"on", "CHANNELS",
         "put the effect on these channels: names such as L,R or numbers from 1; the others pass by", Values::Text},
        {"side-chain", "FILE", "feed this sound file into the plug-in's side-chain bus", Values::File},
    };
}

std::vector<OptionSpec> TimeOptions()
{
    return {
        {"automation", "FILE", "change parameters over time: lines of seconds, parameter, value", Values::File},
        {"block", "FRAMES", "frames in a block (default 512)", Values::Number},
        {"tail", "LENGTH",
         "what follows the end: auto, seconds, or a level such as -90dB to fall below (default auto)", Values::Text},
        {"no-trim", "", "keep the silence that the plug-in's latency puts in front"},
        {"tempo", "BPM", "tempo that the plug-in is told (default 120)", Values::Number},
        {"time-sig", "N/D", "time signature that the plug-in is told (default 4/4)", Values::Text},
        {"realtime", "", "tell the plug-in that it runs in real time instead of offline"},
        {"settle", "MILLISECONDS",
         "serve the plug-in's timers this long after loading and after each change of state (default 50)",
         Values::Number},
    };
}

void Append(std::vector<OptionSpec>& options, const std::vector<OptionSpec>& more)
{
    options.insert(options.end(), more.begin(), more.end());
}

} // namespace

std::vector<CommandSpec> RenderCommands()
{
    CommandSpec command = {
        "render",
        "run sound files through an effect",
        "FILE is an input and an output, or with --out-dir any number of inputs. Every format that libsndfile reads "
        "will do, with any number of channels at any rate. The plug-in's latency is cut off the front, and the "
        "output "
        "gets the plug-in's tail. Channels that the effect does not take pass by, delayed by its latency and "
        "otherwise "
        "unchanged. An output file appears when it is complete, or not at all.",
        {FilterOperand(), {"FILE", "IN OUT, or inputs when --out-dir is given", Values::File, true, true}},
        ParameterOptions(),
        {{"zebhost render Gain --set Gain=-6 in.wav out.wav", "6 dB softer"},
         {"zebhost render Compressor --on L,R --side-chain voice.wav film51.wav out51.wav",
          "two channels of six, ducked by a voice"},
         {"zebhost render Reverb --tail -90dB --out-dir wet *.flac",
          "many files, each until its echo has died away"}},
    };
    Append(command.options, OutputOptions());
    Append(command.options, RoutingOptions());
    Append(command.options, TimeOptions());
    return {command};
}

} // namespace zebhost
