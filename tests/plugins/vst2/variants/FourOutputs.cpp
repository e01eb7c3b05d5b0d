// Two pins in and four out.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kOutputs] = 4;
    behaviour[Knob::kAcceptArrangements] = 0;
}
