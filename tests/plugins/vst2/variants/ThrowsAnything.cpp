// Throws whenever it gets sound, and no std::exception.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kProcessThrows] = 2;
}
