#pragma once

namespace soak::interrupt
{

/// From now on Ctrl-C and a request to terminate end the run early, with its figures; it has not passed then.
void Watch();

bool IsRequested();

} // namespace soak::interrupt
