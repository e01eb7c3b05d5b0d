// Says that it has less than no parameters, programs and pins.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kParameterCount] = -1;
    behaviour[Knob::kProgramCount] = -1;
    behaviour[Knob::kInputs] = -1;
    behaviour[Knob::kOutputs] = -1;
    behaviour[Knob::kAcceptArrangements] = 0;
}
