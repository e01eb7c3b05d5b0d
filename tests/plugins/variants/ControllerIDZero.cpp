// The ID of the controller class is all zeros.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kControllerIDZero] = 1;
}
