#pragma once

#include "editor/Picture.h"

#include <audiofilter/AudioFilter.h>

#include <string>

namespace zebhost
{

// What came of an open editor.
struct EditorOutcome
{
    Picture picture;     // what the window showed last; empty unless it was wanted
    std::string trouble; // the first exception of the plug-in's; empty without one
};

// Opens a filter's editor in a window and serves it until the window is closed, Ctrl-C is pressed, or the time is
// over (0 never ends). Throws a Failure if there is no editor or no screen. [main]
EditorOutcome RunEditor(zebaudiofilterhost::AudioFilter& filter, const std::string& title, unsigned int milliseconds,
                        bool wantPicture);

} // namespace zebhost
