// Two hundred pins each way.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kInputs] = 200;
    behaviour[Knob::kOutputs] = 200;
    behaviour[Knob::kAcceptArrangements] = 0;
}
