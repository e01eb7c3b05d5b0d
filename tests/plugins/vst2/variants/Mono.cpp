// One pin each way, and no arrangements.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kInputs] = 1;
    behaviour[Knob::kOutputs] = 1;
    behaviour[Knob::kAcceptArrangements] = 0;
}
