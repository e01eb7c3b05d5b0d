// A latency that is negative when taken as signed.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kLatency] = 4294967295.0;
}
