// Four pins in and two out.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kInputs] = 4;
    behaviour[Knob::kAcceptArrangements] = 0;
}
