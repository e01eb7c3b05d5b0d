// Six pins each way, and no arrangements.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kInputs] = 6;
    behaviour[Knob::kOutputs] = 6;
    behaviour[Knob::kAcceptArrangements] = 0;
}
