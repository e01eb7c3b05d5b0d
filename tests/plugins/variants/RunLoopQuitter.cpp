// Takes back both registrations from inside its first callback.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.usesRunLoop = true;
    behaviour[Knob::kUnregisterInCallback] = 1;
}
