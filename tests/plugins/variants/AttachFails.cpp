// A view that can't be attached.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kAttachedResult] = kInternalError;
}
