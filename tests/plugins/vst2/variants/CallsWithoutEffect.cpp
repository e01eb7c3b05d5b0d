// Calls its host from within effOpen and effClose, without saying who calls.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCallsInOpen] = 1;
    behaviour[Knob::kCallsInClose] = 1;
    behaviour[Knob::kCallsWithoutEffect] = 1;
}
