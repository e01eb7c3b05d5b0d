#include "cli/CommandTableParts.h"

namespace zebhost
{

OperandSpec FilterOperand()
{
    return {"FILTER", "a filter ID, a name that fits one filter, a plug-in's path, or path#name", Values::Filter};
}

std::vector<OptionSpec> ParameterOptions()
{
    return {
        {"preset", "PRESET", "start from a preset: a stored one, one of the plug-in's own, or a preset file",
         Values::File},
        {"set", "NAME=TEXT", "set a parameter to what the plug-in displays, such as Gain=-6 or Mode=Slow",
         Values::Text, true},
        {"norm", "NAME=VALUE", "set a parameter to a normalised value from 0 to 1", Values::Text, true},
    };
}

namespace
{

CommandSpec ScanSpec()
{
    return {
        "scan",
        "find plug-ins and put their effects into the catalogue",
        "Without a PATH the standard places are searched: for VST 3 $VST3_PATH, or else ~/.vst3, "
        "/usr/local/lib/vst3 and /usr/lib/vst3; for VST 2 $VST_PATH, or else /usr/lib/vst, /usr/lib/lxvst, "
        "/usr/local/lib/vst, ~/.vst and ~/.lxvst. Plug-ins that are in the catalogue already are loaded again only "
        "if their binary has changed, and those that have gone are dropped. A PATH is a plug-in (a .vst3, .vst or "
        ".component bundle, or a .so file) or a folder to search; what is found there is always scanned anew. "
        "Plug-ins are "
        "loaded in a process of their own, and the catalogue is saved after each. One that crashes, or does not "
        "answer in time, is blocked, and the scan goes on; it is tried again when its binary has changed. Ctrl-C "
        "ends the scan with everything saved and nothing blocked.",
        {{"PATH", "a plug-in or a folder to search", Values::File, false, true}},
        {
            {"full", "", "scan plug-ins again that are in the catalogue already, or could not be loaded"},
            {"retry-blocked", "", "scan plug-ins again that a scan blocked or could not load"},
            {"dry-run", "", "print what would be scanned, and why; load nothing and save nothing"},
            {"skip-category", "",
             "do not ask plug-ins for their category; instruments of VST 3 then count as effects"},
            {"timeout", "SECONDS", "give up on a plug-in after SECONDS, and block it; 0 waits for ever (default 30)",
             Values::Number},
            {"verbose", "", "show what plug-ins print"},
            {"in-process", "", "load plug-ins in this process, for debugging: a crash ends the scan"},
        },
        {{"zebhost scan", "scan what is new in the standard places"},
         {"zebhost scan ~/build/MyEffect.vst3", "scan one plug-in, wherever it lies"},
         {"zebhost scan --dry-run", "what would be scanned, and why"},
         {"zebhost scan --retry-blocked --verbose", "give blocked plug-ins another chance, and see what they say"}},
    };
}

CommandSpec ListSpec()
{
    return {
        "list",
        "list the effects of the catalogue",
        "With TEXT, only those whose name, vendor, category, ID or path holds TEXT, in any case of its letters. "
        "Instruments are not in the catalogue.",
        {{"TEXT", "what to look for", Values::Text, false}},
        {
            {"long", "", "show version, ID and path as well"},
            {"names", "", "print the names only, one a line"},
        },
        {{"zebhost list", "everything in the catalogue"},
         {"zebhost list reverb --json", "all reverbs, for a script"}},
    };
}

CommandSpec InfoSpec()
{
    return {
        "info",
        "tell what a filter is: buses, latency, tail, presets, editor",
        "Loads the plug-in and asks it.",
        {FilterOperand()},
        {},
        {{"zebhost info Delay", "a filter by its name"},
         {"zebhost info './Suite.vst3#Wide Delay'", "one class of a bundle that was never scanned"}},
    };
}

CommandSpec ParamsSpec()
{
    CommandSpec command = {
        "params",
        "list a filter's parameters with their values",
        "Shows each parameter as the plug-in displays it, and its normalised value. With --preset, --set or --norm "
        "the values after that change are shown, so that a setting can be tried before it is rendered.",
        {FilterOperand()},
        ParameterOptions(),
        {{"zebhost params Gain", "all parameters of Gain"},
         {"zebhost params Gain --set Gain=-6 --json", "what -6 means to the plug-in, for a script"}},
    };
    command.options.push_back({"choices", "", "show all texts of parameters that have steps"});
    return command;
}

} // namespace

std::vector<CommandSpec> CatalogueCommands()
{
    return {ScanSpec(), ListSpec(), InfoSpec(), ParamsSpec()};
}

} // namespace zebhost
