// Calls its host from within effOpen.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCallsInOpen] = 1;
}
