// The component refuses to be initialised.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kInitializeResult] = kInternalError;
}
