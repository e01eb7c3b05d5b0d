#pragma once

#include "cli/Arguments.h"
#include "filter/HostTime.h"

#include <string>

namespace zebhost
{

// What follows the end of the input.
struct TailLength
{
    enum class Kind
    {
        Auto, // as the plug-in says
        Seconds,
        Level // until the output has fallen below
    };

    Kind kind = Kind::Auto;
    double seconds = 0;
    double decibels = -90;

    // How long it can become.
    double LongestSeconds() const;
};

// Throws a usage Failure for anything but "auto", seconds and decibels below zero.
TailLength ParseTail(const std::string& text);

// The options of the render command, checked.
struct RenderOptions
{
    explicit RenderOptions(const Arguments& arguments);

    int block = 512;
    TailLength tail;
    bool trim = true;
    bool realtime = false;
    bool overwrite = false;
    unsigned int settleMs = 0;
    MusicalTime time;
    std::string on;
    std::string sideChain;
    std::string automation;
    std::string format;
};

} // namespace zebhost
