// Asks for a restart from inside process: latency and titles.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kRestartInProcess] = kLatencyChanged | kParamTitlesChanged;
}
