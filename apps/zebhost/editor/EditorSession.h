#pragma once

#include "editor/Picture.h"

#include <audiofilter/AudioFilter.h>

#include <string>

namespace zebhost
{

// Opens a filter's editor in a window and serves it until the window is closed, Ctrl-C is pressed, or the time is
// over (0 never ends). Returns the picture that the window showed last, or an empty one unless it is wanted. Throws a
// Failure if there is no editor or no screen. [main]
Picture RunEditor(zebaudiofilterhost::AudioFilter& filter, const std::string& title, unsigned int milliseconds,
                  bool wantPicture);

} // namespace zebhost
