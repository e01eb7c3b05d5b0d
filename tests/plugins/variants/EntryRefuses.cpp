// The entry point says no, and the factory is there all the same.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kEntryResult] = 0;
}
