// Says that it has many more parameters and programs than it has.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kParameterCount] = 20000;
    behaviour[Knob::kProgramCount] = 20000;
}
