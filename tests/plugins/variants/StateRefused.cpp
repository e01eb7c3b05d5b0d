// Refuses every state that it is given.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kSetStateResult] = kResultFalse;
    behaviour[Knob::kSetComponentStateResult] = kResultFalse;
    behaviour[Knob::kSetControllerStateResult] = kResultFalse;
}
