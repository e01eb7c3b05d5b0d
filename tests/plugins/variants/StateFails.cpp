// Can't give its state.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kStateResult] = kNotImplemented;
    behaviour[Knob::kControllerStateResult] = kNotImplemented;
}
