// Registers a pipe and a timer with the run loop of the host context, and tells its latency at the first tick.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.usesRunLoop = true;
    behaviour[Knob::kLatencyFromTimer] = 64;
}
