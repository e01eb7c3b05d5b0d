// Never takes another arrangement than the one it has.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kAcceptArrangements] = 0;
}
