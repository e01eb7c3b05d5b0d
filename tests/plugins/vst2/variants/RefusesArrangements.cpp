// Stereo pins, and no arrangements.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kAcceptArrangements] = 0;
}
