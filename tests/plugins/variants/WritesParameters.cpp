// process writes the read-only parameter.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kOutputValue] = 0.25;
}
