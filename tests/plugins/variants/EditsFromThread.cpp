// A thread of its own changes a parameter while audio runs.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kThreadEdits] = 1;
}
