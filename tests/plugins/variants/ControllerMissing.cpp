// The factory can't create the controller that the component names.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCreateControllerResult] = kNoInterface;
}
