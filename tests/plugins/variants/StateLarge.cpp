// A state of 8 MB.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kStateSize] = 8 * 1024 * 1024;
}
