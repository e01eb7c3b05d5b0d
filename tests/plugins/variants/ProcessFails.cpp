// process fails for ever.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kProcessResult] = kInternalError;
}
