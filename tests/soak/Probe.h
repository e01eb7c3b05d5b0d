#pragma once

#include "ProcessThread.h"
#include "Subject.h"

#include <cstdint>

namespace soak
{

/// A hash of what a new filter of the effect makes of fixed noise, each parameter set to the value that it tells.
/// [main]
std::uint64_t ProbeSound(const Subject& subject, ProcessThread& thread);

} // namespace soak
