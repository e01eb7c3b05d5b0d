#include "cli/CommandTableParts.h"

namespace zebhost
{

namespace
{

OperandSpec PresetOperand()
{
    return {"PRESET", "a name in the preset store, or a file: something with a slash in it, or ending in .xml",
            Values::File};
}

CommandSpec SaveSpec()
{
    CommandSpec command = {
        "preset save",
        "save a filter's settings",
        "Loads the filter, applies --preset, --set and --norm, and saves what the plug-in then has.",
        {FilterOperand(), PresetOperand()},
        ParameterOptions(),
        {{"zebhost preset save Gain soft --set Gain=-6", "into the preset store"},
         {"zebhost preset save Gain ./soft.xml --preset soft", "from the store into a file"}},
    };
    command.options.push_back({"overwrite", "", "replace a preset that exists"});
    return command;
}

CommandSpec LoadSpec()
{
    return {
        "preset load",
        "load settings into a filter and show its parameters",
        "Shows whether the plug-in takes the preset, and the parameters that it then has.",
        {FilterOperand(), PresetOperand()},
        {},
        {{"zebhost preset load Gain soft", "a preset of the store"},
         {"zebhost preset load Gain ./soft.xml --json", "a preset file, for a script"}},
    };
}

CommandSpec PresetListSpec()
{
    return {
        "preset list",
        "list stored presets, and those that a plug-in brings along",
        "Without FILTER all stored presets of all filters.",
        {{"FILTER", "a filter ID, a name that fits one filter, a plug-in's path, or path#name", Values::Filter,
          false}},
        {},
        {{"zebhost preset list", "all stored presets"},
         {"zebhost preset list Suite.vst3", "of one filter, with the plug-in's own"}},
    };
}

} // namespace

std::vector<CommandSpec> PresetCommands()
{
    return {SaveSpec(), LoadSpec(), PresetListSpec()};
}

std::vector<CommandSpec> EditorCommands()
{
    CommandSpec command = {
        "edit",
        "open a plug-in's editor in a window",
        "Runs until the window is closed. What was changed can be kept with --save.",
        {FilterOperand()},
        ParameterOptions(),
        {{"zebhost edit Gain", "until the window is closed"},
         {"zebhost edit Gain --preset soft --save soft --overwrite",
          "change a stored preset in the plug-in's editor"}},
    };
    command.options.push_back({"save", "PRESET", "save the settings when the window is closed", Values::File});
    command.options.push_back({"overwrite", "", "replace a preset or picture that exists"});
    command.options.push_back({"seconds", "N", "close the window by itself after N seconds", Values::Number});
    command.options.push_back(
        {"screenshot", "FILE", "write a PNG picture of the window before it is closed", Values::File});
    return {command};
}

} // namespace zebhost
