#pragma once

namespace zebhost::interrupt
{

// From now on the first Ctrl-C, hang-up or termination request is only noted, so that work can end cleanly between
// two steps. The second ends the process at once.
void Watch();

bool IsRequested();

} // namespace zebhost::interrupt
