// Calls its host from a thread of its own while it is on.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kThreadCalls] = 1;
}
