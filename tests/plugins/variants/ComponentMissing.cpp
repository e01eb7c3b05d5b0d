// The factory can't create the component.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCreateComponentResult] = kResultFalse;
}
