// The factory tells nothing about itself: the class record's name is the only one that a host gets.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kFactoryInfoResult] = kInternalError;
}
