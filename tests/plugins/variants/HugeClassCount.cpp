// countClasses promises two thousand million classes and has two.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kClassCount] = 2147483647;
}
