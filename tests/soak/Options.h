#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace soak
{

struct Options
{
    int seconds = 3600;
    unsigned long operations = 0;  // ends the run too, so that a start can be repeated to the end; 0 for no such end
    std::uint64_t randomStart = 0; // 0 for a new one
    int everySeconds = 60;         // between two lines
    bool withEditors = true;
    std::vector<std::string> withoutEditorOf; // parts of paths
    std::string only;                         // a part of the names
    std::vector<std::string> leftOut;         // parts of names, told with the findings
    std::string json;                         // a file; empty for none
    std::string log;                          // a file for what plug-ins print; empty for nowhere
};

/// Ends the process with a word of help for what it does not know.
Options ReadOptions(int argc, char** argv);

} // namespace soak
