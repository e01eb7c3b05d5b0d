// No pins at all.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kInputs] = 0;
    behaviour[Knob::kOutputs] = 0;
    behaviour[Knob::kAcceptArrangements] = 0;
}
