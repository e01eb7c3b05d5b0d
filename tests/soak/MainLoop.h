#pragma once

namespace soak
{

/// Serves what the main thread's loop has to do now. Throws LoopError for what a handler throws. [main]
void ServeLoop();

/// The same for so long. [main]
void Settle(unsigned int milliseconds);

} // namespace soak
