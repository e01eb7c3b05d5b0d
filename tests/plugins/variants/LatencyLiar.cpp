// Says 100 samples of latency and delays by none.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kLatency] = 100;
}
