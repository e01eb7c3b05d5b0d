// A state of no bytes, in both halves.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kStateSize] = 0;
    behaviour[Knob::kControllerStateSize] = 0;
}
