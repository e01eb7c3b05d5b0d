// Throws whenever a parameter is set or asked for.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kParameterThrows] = 1;
}
