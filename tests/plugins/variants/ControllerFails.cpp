// The controller refuses to be initialised.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kControllerInitializeResult] = kInternalError;
}
