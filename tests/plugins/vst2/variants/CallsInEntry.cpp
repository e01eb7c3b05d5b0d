// Calls its host from the entry point: without an instance, and with one that the host does not know yet.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCallsInEntry] = 1;
}
