// An effect without a controller, and with 10 bytes of state.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kControllerIDResult] = kNotImplemented;
    behaviour[Knob::kStateSize] = 10;
}
