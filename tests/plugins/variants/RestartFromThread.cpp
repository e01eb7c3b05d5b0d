// A thread of its own asks for restarts while audio runs.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kThreadRestarts] = kLatencyChanged | kParamTitlesChanged;
}
